// The files that tell of recordings. Whatever the text, it is refused with a reason or reads back
// as the same when it was written again.
#include "host/recording/RecordingFile.h"

#include <cstdint>
#include <cstdlib>

namespace {

// A broken promise ends the program, which is how a fuzzer learns of it.
void require(bool promise) {
    if (!promise)
        std::abort();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const auto read = quarn::parseRecordingFile({reinterpret_cast<const char*>(bytes), size}, "f");
    if (!read) {
        require(!read.message().empty());
        return 0;
    }
    require(read.value().writer.pid >= 0 && read.value().settings.frames >= 0);
    const auto again = quarn::parseRecordingFile(quarn::recordingFileText(read.value()), "f");
    require(again.ok() && again.value() == read.value());
    return 0;
}
