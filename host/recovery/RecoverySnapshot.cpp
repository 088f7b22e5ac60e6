#include "host/recovery/RecoverySnapshot.h"

#include "engine/images/SmallPicture.h"
#include "host/app/DocumentSaving.h"
#include "host/document/Document.h"
#include "host/document/file/FileRemainder.h"

namespace quarn {

namespace {

constexpr int PICTURE_SIDE_PX = 320;

Image newPicture(const ViewState& view, ShownView& shown) {
    const ShownView now{&view, view.showCount()};
    if (now == shown || view.frameBuffer().width == 0)
        return {};
    shown = now;
    return smallPicture(view.frameBuffer(), PICTURE_SIDE_PX);
}

/// What a plug-in cannot write leaves the rest worth keeping.
DocumentContent contentOf(Document& document, std::optional<std::string>& trouble) {
    DocumentContent content = document.contentWithoutObjects();
    const auto added = addPlugInContent(document, content);
    if (added)
        return content;
    trouble = "Recovery keeps the document without its plug-ins' part: " + added.message() + ".";
    content.plug_ins = document.fileRemainder().plug_ins;
    content.unknown = document.fileRemainder().unknown;
    return content;
}

} // namespace

RecoveryMatter recoveryMatterOf(const Document& document) {
    RecoveryMatter matter;
    matter.saved = savedStateOf(document);
    for (const auto& view : document.views()) {
        if (view.get() == &document.activeView())
            matter.active_camera = matter.cameras.size();
        matter.cameras.push_back(view->viewport());
    }
    return matter;
}

RecoverySnapshot snapshotOf(Document& document, std::shared_ptr<const ObjectCopies> objects,
                            ShownView& shown) {
    RecoverySnapshot snapshot;
    snapshot.state = std::make_unique<RecoveryState>();
    snapshot.state->document = document.file();
    snapshot.state->kept_at = std::chrono::system_clock::now();
    snapshot.state->content = contentOf(document, snapshot.trouble);
    snapshot.state->objects = std::move(objects);
    snapshot.state->picture = newPicture(document.activeView(), shown);
    return snapshot;
}

} // namespace quarn
