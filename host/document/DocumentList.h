#pragma once

#include "host/document/Document.h"

#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

class IQnZoetrixDynamicAccess;

namespace quarn {

class FrontEnd;

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

    /// Called when the outermost command starts: until it has ended no document and no view closes,
    /// because the command may hold it.
    void commandStarted() {
        m_is_command_running = true;
        ++m_command_count;
    }
    /// How many outermost commands have started.
    std::uint64_t commandCount() const { return m_command_count; }
    /// Called when a plug-in placed the camera of a view or chose its display mode.
    void viewPlaced(ViewState& view);
    /// The view that pictures of a document are rendered of: the one that the running command has
    /// placed last, as one that records places the view of the animation; else the active one.
    ViewState& viewToRender(const Document& document) const;
    /// Why the running command could not save the picture that it rendered last; empty when it
    /// could, and when no command runs.
    const std::string& unsavedPicture() const { return m_unsaved_picture; }
    void noteUnsavedPicture(std::string why) { m_unsaved_picture = std::move(why); }
    /// Asks, while an animation is recorded, whether the pictures that are asked for now are
    /// wanted; those that are not are left as they are and count as drawn. Null: all are wanted.
    void setWantsPictures(std::function<bool()> wants) { m_wants_pictures = std::move(wants); }
    bool wantsPictures() const { return !m_wants_pictures || m_wants_pictures(); }
    /// Called when the outermost command has ended: closes every document but the active one, and
    /// does to its views what was put off until then.
    void commandEnded();
    bool isCommandRunning() const { return m_is_command_running; }

    /// Closes every document. What plug-ins have seen of them stays, as a shell that refuses every
    /// call, until the list goes.
    void closeAll();

    /// The active document, or null when none was opened.
    Document* active() const { return m_active; }
    /// The open document with this number, or null.
    Document* find(unsigned int serial_number) const;
    const std::vector<std::unique_ptr<Document>>& documents() const { return m_documents; }

    FrontEnd& frontEnd() const { return m_front_end; }

    /// Keeps a copy of the animation record as it is now: the one that a new document starts with.
    /// Called after every load of a plug-in; does nothing unless the record is another object's
    /// than at the last call.
    void rememberFreshRecord();

private:
    void emptyAnimationRecord(Document& document);
    void closeAllBut(const Document* kept);

    FrontEnd& m_front_end;
    std::vector<std::unique_ptr<Document>> m_documents;
    std::vector<std::unique_ptr<Document>> m_closed_documents;
    Document* m_active = nullptr;
    bool m_is_command_running = false;
    std::uint64_t m_command_count = 0;
    ViewState* m_placed_view = nullptr; ///< by the command that runs; null: none
    std::string m_unsaved_picture;
    std::function<bool()> m_wants_pictures;
    std::unique_ptr<KM_3dmAnimationProperties> m_fresh_record;
    const IQnZoetrixDynamicAccess* m_fresh_record_access = nullptr; ///< whose it is; never called
};

} // namespace quarn
