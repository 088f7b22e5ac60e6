#include "host/reader/ReaderEnds.h"

#include "ground/FreeMemory.h"
#include "ground/PathText.h"
#include "sdk/qncore/QnLocalize.h"

#include <csignal>

namespace quarn {

namespace {

template <class... Values>
Error sentence(const wchar_t* format, const std::filesystem::path& path, const Values&... values) {
    return {KM_wString::FormatToString(format, textFromPath(path.filename()).Array(), values...)
                .ToUtf8()};
}

} // namespace

Error cannotStartReader(const std::filesystem::path& path, std::string_view why) {
    return sentence(QnLocalizeString(L"%s could not be read: the program that reads model files "
                                     L"cannot be started (%s).",
                                     42601),
                    path, KM_wString::FromUtf8(why).Array());
}

Error readerStopped(const std::filesystem::path& path, int signal) {
    // A file that is shorter than it was when it was opened ends whoever reads on.
    if (signal == SIGBUS)
        return sentence(QnLocalizeString(L"%s could not be read: the file changed while it was "
                                         L"read. Try again when it is complete.",
                                         42602),
                        path);
    return sentence(QnLocalizeString(L"%s could not be read: the reader stopped unexpectedly. The "
                                     L"file may be damaged: export it again, or in another format.",
                                     42603),
                    path);
}

Error readingTookTooLong(const std::filesystem::path& path, std::chrono::milliseconds longest) {
    const auto seconds = std::chrono::ceil<std::chrono::seconds>(longest).count();
    return sentence(
        QnLocalizeString(L"%s could not be read: it took longer than %d s. The file may "
                         L"be damaged: export it again, or in another format.",
                         42604),
        path, static_cast<int>(seconds));
}

Error readingNeedsMore(const std::filesystem::path& path, std::uint64_t most_memory) {
    return sentence(QnLocalizeString(L"%s could not be read: it needs more than the %s of memory "
                                     L"that reading may take (--limit-memory). The file may be "
                                     L"damaged; else use a smaller model.",
                                     42605),
                    path, KM_wString::FromUtf8(gigabyteText(most_memory)).Array());
}

Error readingGivenUp(const std::filesystem::path& path) {
    return sentence(QnLocalizeString(L"%s was not read: it was given up.", 42606), path);
}

Error cannotTakeModel(const std::filesystem::path& path, std::string_view why) {
    return sentence(QnLocalizeString(L"%s could not be read: %s.", 42607), path,
                    KM_wString::FromUtf8(why).Array());
}

} // namespace quarn
