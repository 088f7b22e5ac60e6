#include "host/commands/HostCommands.h"
#include "host/commands/ModelReading.h"
#include "host/document/DocumentList.h"

namespace quarn {

CQuarnCommand::result runImport(const CQuarnCommandContext& context) {
    AskedFile asked = askFileToRead(context, FileUse::import);
    if (asked.result == CQuarnCommand::success)
        addToDocument(Document::of(context.Document()), asked);
    return asked.result;
}

CQuarnCommand::result runNew(const CQuarnCommandContext& context) {
    Document::of(context.Document()).list().openNew();
    return CQuarnCommand::success;
}

/// The file is read first: when it cannot be, the document at work stays.
CQuarnCommand::result runOpen(const CQuarnCommandContext& context) {
    AskedFile asked = askFileToRead(context, FileUse::open);
    if (asked.result == CQuarnCommand::success)
        openAsDocument(Document::of(context.Document()).list(), asked);
    return asked.result;
}

} // namespace quarn
