#pragma once

#include "host/document/Document.h"

#include <memory>
#include <vector>

namespace quarn {

class FrontEnd;
class ImageEncoder;

/// The open documents. There is at most one list at a time: the interface finds documents by
/// number and objects by id with no list given, so the list is known to all.
class DocumentList {
public:
    /// An empty list. @param front_end  whom documents and views talk to; must outlive the list
    explicit DocumentList(FrontEnd& front_end);
    ~DocumentList();
    DocumentList(const DocumentList&) = delete;
    DocumentList& operator=(const DocumentList&) = delete;

    /// The list that exists now, or null.
    static DocumentList* current();

    /// Opens a new document and makes it the active one. The document that was active stays open
    /// until commandEnded, because a running command may hold it. The animation record that a
    /// plug-in keeps is emptied first, so that nothing of the old document stays in it.
    Document& openNew();

    /// Called when the outermost command has ended: closes every document but the active one.
    void commandEnded();

    /// The active document, or null when none was opened.
    Document* active() const { return m_active; }
    /// The open document with this number, or null.
    Document* find(unsigned int serial_number) const;
    const std::vector<std::unique_ptr<Document>>& documents() const { return m_documents; }

    FrontEnd& frontEnd() const { return m_front_end; }

    /// Writes picture files; kept here so that its buffers serve every frame.
    ImageEncoder& imageEncoder() { return *m_image_encoder; }

    /// Keeps a copy of the animation record as it is now: the one that a new document starts with.
    /// Called once after a plug-in that keeps a record was loaded.
    void rememberFreshRecord();

private:
    void emptyAnimationRecord(Document& document);

    FrontEnd& m_front_end;
    std::vector<std::unique_ptr<Document>> m_documents;
    Document* m_active = nullptr;
    std::unique_ptr<ImageEncoder> m_image_encoder;
    std::unique_ptr<KM_3dmAnimationProperties> m_fresh_record;
};

} // namespace quarn
