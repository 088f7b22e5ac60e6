// The journals of recordings. Whatever the text, it is refused with a reason or reads back as the
// same when it was written again, whole and in pieces.
#include "host/recording/RecordingJournal.h"

#include <cstdint>
#include <cstdlib>

namespace {

// A broken promise ends the program, which is how a fuzzer learns of it.
void require(bool promise) {
    if (!promise)
        std::abort();
}

std::string textOf(const quarn::RecordingJournal& journal) {
    std::string text = quarn::journalHeadLine(journal.head);
    for (const quarn::JournalFrame& frame : journal.frames)
        text += quarn::journalFrameLine(frame);
    return journal.has_ended ? text + quarn::journalEndLine(journal.trouble) : text;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    quarn::JournalReader read("f");
    if (const auto taken = read.take({reinterpret_cast<const char*>(bytes), size}); !taken) {
        require(!taken.message().empty());
        return 0;
    }
    if (!read.hasHead())
        return 0;
    const std::string text = textOf(read.content());
    quarn::JournalReader again("f");
    require(again.take(text).ok() && again.content() == read.content());
    return 0;
}
