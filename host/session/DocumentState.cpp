#include "host/session/DocumentState.h"

#include "host/commands/FileAsking.h"
#include "host/document/Document.h"

namespace quarn {

std::filesystem::path documentFile(CQuarnDoc& document) {
    return Document::of(document).file();
}

bool isModified(CQuarnDoc& document) {
    return Document::of(document).isModified();
}

std::filesystem::path firstFolder() {
    return firstChooserFolder();
}

int objectCount(CQuarnDoc& document) {
    return static_cast<int>(Document::of(document).objects().objects().size());
}

} // namespace quarn
