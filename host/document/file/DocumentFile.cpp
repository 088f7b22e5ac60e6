#include "host/document/file/DocumentFile.h"

#include "ground/FileBytes.h"
#include "ground/PathText.h"
#include "host/document/file/DocumentCoding.h"

#include <span>

namespace quarn {

namespace {

Error cannot(const char* verb, const std::filesystem::path& file, const std::string& why) {
    return {std::string("Cannot ") + verb + " " + textFromPath(file).ToUtf8() + ": " + why + "."};
}

} // namespace

Result<WrittenFile> writeDocumentFile(const DocumentContent& content,
                                      const std::filesystem::path& file, Protection protection) {
    const auto bytes = encodeDocument(content);
    if (!bytes)
        return cannot("save", file, bytes.message());
    return writeFileToDisk(file, std::as_bytes(std::span(bytes.value())), protection);
}

Result<DocumentContent> readDocumentFile(const std::filesystem::path& file) {
    const auto bytes = readFileBytes(file);
    if (!bytes)
        return cannot("read", file, bytes.message());
    auto content = decodeDocument(bytes.value().bytes());
    if (!content)
        return cannot("read", file, content.message());
    return content;
}

} // namespace quarn
