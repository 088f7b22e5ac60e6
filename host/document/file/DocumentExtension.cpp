#include "host/document/file/DocumentExtension.h"

#include "ground/PathText.h"

namespace quarn {

bool isDocumentFile(const std::filesystem::path& file) {
    const KM_wString extension = textFromPath(file.extension());
    return extension.CompareNoCase(KM_wString::FromUtf8(DOCUMENT_EXTENSION)) == 0;
}

} // namespace quarn
