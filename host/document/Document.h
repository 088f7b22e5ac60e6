#pragma once

#include "engine/scene/UnitSystem.h"
#include "ground/Result.h"
#include "host/document/DocumentSun.h"
#include "host/document/LightStore.h"
#include "host/document/ObjectTable.h"
#include "host/document/RenderWindow.h"
#include "host/document/StudiedPlace.h"
#include "host/document/ViewState.h"
#include "kelmar/KM_AnimationProperties.h"
#include "sdk/qncore/QnDoc.h"

#include <chrono>
#include <filesystem>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

class DocumentDrawing;
class DocumentList;
class FrontEnd;
enum class MeshEdgeChoice : int;
struct DocumentContent;
struct FileRemainder;
struct ImportedModel;
struct ReadingNotes;
struct ObjectContent;
struct SavedState;

using ObjectCopies = std::vector<std::shared_ptr<const ObjectContent>>;

/// A camera that a model file brought along.
struct NamedView {
    KM_wString name;
    KM_Viewport viewport;
};

/// A document: objects, lights, sun and views. Owned by the DocumentList, also when it was closed:
/// a plug-in may keep a pointer to what it sees of it.
class Document {
public:
    /// The tolerance of a document that no model was read into, in document units.
    static constexpr double default_absolute_tolerance = 0.001;

    /// A document without objects and with four views: Top, Front and Right in parallel
    /// projection, and Perspective, which is active.
    Document(DocumentList& list, unsigned int serial_number);
    ~Document();
    Document(const Document&) = delete;
    Document& operator=(const Document&) = delete;

    /// The document behind the one that plug-ins see.
    static Document& of(const CQuarnDoc& document);
    CQuarnDoc& face() { return m_face; }
    const CQuarnDoc& face() const { return m_face; }

    unsigned int serialNumber() const { return m_serial_number; }
    DocumentList& list() const { return m_list; }
    FrontEnd& frontEnd() const;

    /// Called by the list when it closes the document: its views close and its objects go. From now
    /// on every call on what plug-ins see of it is a breach.
    void close();
    bool isOpen() const { return m_is_open; }

    ObjectTable& objects() { return m_objects; }
    const ObjectTable& objects() const { return m_objects; }
    LightStore& lights() { return m_lights; }
    const LightStore& lights() const { return m_lights; }
    DocumentSun& sun() { return m_sun; }
    const DocumentSun& sun() const { return m_sun; }
    /// Which edges of meshes a display mode draws in this document.
    MeshEdgeChoice edgesOf(const KM_UUID& display_mode) const;
    void setEdgesOf(const KM_UUID& display_mode, MeshEdgeChoice choice);
    /// The choices that are not as the display mode has it, by display mode.
    const std::map<KM_UUID, MeshEdgeChoice>& edges() const { return m_edges; }
    CQuarnDocProperties& properties() { return m_properties; }

    const std::vector<std::unique_ptr<ViewState>>& views() const { return m_views; }
    /// There is always one while the document is open.
    ViewState& activeView() const { return *m_active_view; }
    /// The view with this name, ignoring case, or null.
    ViewState* findView(std::wstring_view name) const;
    /// Makes the view with this name, ignoring case, the active one. @return false: there is none
    bool activateView(std::wstring_view name);
    /// Makes one of the document's views the active one; while a command runs, when the outermost
    /// one has ended: a command goes on with the view that it began with.
    void activateWhenIdle(ViewState& view);
    /// As ViewState::setFrameSize; while a command runs, when the outermost one has ended, so that
    /// all pictures of a recording have one size. A view of that size already keeps its picture.
    bool setFrameSizeWhenIdle(ViewState& view, int width_px, int height_px);
    /// Whether a view may be added under this name.
    /// @return an error for an empty name, one with control characters, and one that a view has
    Result<void> checkNewViewName(const KM_wString& name) const;
    /// Adds a view behind the others: 1280 by 720 pixels, drawn as wireframe in parallel projection
    /// and shaded in perspective. The active view stays.
    /// @return the view, or the error of checkNewViewName
    Result<ViewState*> addView(const KM_wString& name, const KM_Viewport& viewport);
    /// The display mode that a new view gets: shaded in perspective, else wireframe.
    static const KM_UUID& standardModeFor(const KM_Viewport& viewport);
    /// Closes the view with this name, ignoring case; while a command runs, when the outermost one
    /// has ended. When it was the active one, the view behind it becomes active, or the last one.
    /// @return an error when there is no such view and when no view would be left
    Result<void> closeView(std::wstring_view name);
    /// Called when the outermost command has ended: does to the views what was put off until then.
    void settleViews();
    const std::vector<NamedView>& namedViews() const { return m_named_views; }

    double absoluteTolerance() const { return m_absolute_tolerance; }
    UnitSystem units() const { return m_units; }

    /// The document file that the document was opened from or saved to last; empty when there is
    /// none.
    const std::filesystem::path& file() const { return m_file; }
    void setFile(const std::filesystem::path& file) { m_file = file; }
    /// The mark of the recovery file that the document was opened from; empty when it was not.
    const std::filesystem::path& recoveredFrom() const { return m_recovered_from; }
    void setRecoveredFrom(const std::filesystem::path& mark) { m_recovered_from = mark; }

    /// Whether what a file of it holds was changed since the last call of markSaved; cameras, the
    /// active view and the selection do not count, nor does what playing alone changes of the
    /// animation record. Looks at everything but coordinates: some milliseconds for large
    /// documents.
    bool isModified() const;
    /// The same, where the state that the document has now is known already.
    bool isModified(const SavedState& now) const;
    /// Called when the document was made, opened or saved: as it is now, it is not modified.
    void markSaved();
    /// How often markSaved was called.
    unsigned saveCount() const { return m_save_count; }
    /// Called when what the document holds was never in its file: it is modified until it is saved.
    void markUnsaved();
    /// Called when a plug-in began to keep the animation record of the document.
    void markRecordSaved();

    /// What of the file it came from nobody here understands, to be written back.
    FileRemainder& fileRemainder() { return *m_file_remainder; }

    /// Adds all that a model file holds. Meshes are shared, not copied. The tolerance becomes a
    /// millionth of the box of all objects in range where that is less than it was, so that a model
    /// of a millimetre in a document of metres is not smaller than what counts as one point. A
    /// document without objects takes over the units of the model.
    void addModel(const ImportedModel& model);
    /// Of the model file that was added last; null where none was.
    const ReadingNotes* readingNotes() const { return m_reading_notes.get(); }

    /// Takes over what a document file holds, in place of what the document has; for a document
    /// that was opened for the file just now. What plug-ins keep is not looked at.
    /// @return what could not be taken over, in sentences for the person
    std::vector<std::string> openContent(const DocumentContent& content);
    /// Adds the objects, cameras and lights of a document file.
    /// @return the index here of each light, by its index in the file
    std::map<int, int> addContent(const DocumentContent& content);
    /// What a document file has to hold of the document; what plug-ins keep is left out.
    /// @param only_selected  take the selected objects alone, without views, cameras and lights
    DocumentContent content(bool only_selected) const;
    /// The same of the whole document, without its objects.
    DocumentContent contentWithoutObjects() const;
    /// Copies of all objects as content has them, for other threads: what changes later makes new
    /// ones. A copy of an object that did not change is the one that was made before.
    /// @param end  when the call has to end
    /// @return null when not all of them were made until then; the next call goes on
    std::shared_ptr<const ObjectCopies>
    objectCopies(std::chrono::steady_clock::time_point end) const;

    /// Draws the document.
    DocumentDrawing& drawing() { return *m_drawing; }
    const DocumentDrawing& drawing() const { return *m_drawing; }
    /// The place that a person gave the sun study. Another study that was set up since has other
    /// coordinates: it is nothing then, whatever was given.
    std::optional<StudiedPlace> studiedPlace() const;
    void setStudiedPlace(const StudiedPlace& place) { m_studied_place = place; }
    /// The part of a sun study that others are put behind. Not saved.
    std::optional<KM_3dmAnimationProperties>& firstPartOfStudy() { return m_first_part; }

    RenderWindow& renderWindow() { return m_render_window; }
    const RenderWindow& renderWindow() const { return m_render_window; }

private:
    void addStandardViews();
    void closeAllViews();
    DocumentContent settingsContent() const;
    void addObjects(const DocumentContent& content);
    void addCameras(const DocumentContent& content);
    std::vector<std::string> replaceViews(const DocumentContent& content);
    void fitTolerance();
    void closeNow(ViewState& view);
    void closeDueViews();
    void resizeDueFrames();

    DocumentList& m_list;
    unsigned int m_serial_number;
    ObjectTable m_objects;
    LightStore m_lights;
    DocumentSun m_sun;
    std::map<KM_UUID, MeshEdgeChoice> m_edges; ///< by display mode; none: as the mode has it
    double m_absolute_tolerance = default_absolute_tolerance;
    UnitSystem m_units = UnitSystem::none;
    std::filesystem::path m_file;
    std::filesystem::path m_recovered_from;
    std::unique_ptr<FileRemainder> m_file_remainder;
    std::unique_ptr<SavedState> m_saved_state; ///< null until markSaved
    unsigned m_save_count = 0;
    mutable std::shared_ptr<const ObjectCopies> m_object_copies; ///< null: none were made yet
    mutable std::uint64_t m_copied_changes = 0; ///< of the objects, when they were made
    std::vector<NamedView> m_named_views;
    std::shared_ptr<const ReadingNotes> m_reading_notes;
    std::vector<std::unique_ptr<ViewState>> m_views;
    ViewState* m_active_view = nullptr;
    std::vector<ViewState*> m_due_views; ///< to be closed when the command ends
    struct FrameSize {
        int width_px;
        int height_px;
    };
    std::map<ViewState*, FrameSize> m_due_frame_sizes; ///< to be set when the command ends
    ViewState* m_due_active_view = nullptr;            ///< to be active then; null: as it is
    std::vector<std::unique_ptr<ViewState>> m_closed_views;
    bool m_is_open = true;
    std::unique_ptr<DocumentDrawing> m_drawing;
    RenderWindow m_render_window;
    std::optional<StudiedPlace> m_studied_place;
    std::optional<KM_3dmAnimationProperties> m_first_part;
    CQuarnDocProperties m_properties;
    CQuarnDoc m_face;

    friend class ::CQuarnDoc;
};

} // namespace quarn
