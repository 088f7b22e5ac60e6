#include "host/document/Document.h"

#include "engine/display/DisplayMode.h"
#include "host/border/Border.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentList.h"
#include "host/document/SavedState.h"
#include "host/document/StandardViews.h"
#include "host/document/file/FileRemainder.h"
#include "host/front_end/FrontEnd.h"
#include "import/ModelFile.h"
#include "kelmar/KM_PolylineCurve.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

#include <algorithm>
#include <utility>

namespace quarn {

namespace {

/// How far the cameras of a new document stand from the origin, in model units.
constexpr double START_DISTANCE = 80.0;

/// The share of the model's size below which two points count as one.
constexpr double TOLERANCE_OF_SIZE = 1e-6;

} // namespace

const KM_UUID& Document::standardModeFor(const KM_Viewport& viewport) {
    return viewport.IsPerspectiveProjection() ? shaded_mode_id : wireframe_mode_id;
}

Document::Document(DocumentList& list, unsigned int serial_number)
    : m_list(list), m_serial_number(serial_number),
      m_file_remainder(std::make_unique<FileRemainder>()),
      m_drawing(std::make_unique<DocumentDrawing>(*this)), m_properties(*this), m_face(*this) {
    addStandardViews();
}

Document::~Document() = default;

Document& Document::of(const CQuarnDoc& document) {
    return *document.m_document;
}

FrontEnd& Document::frontEnd() const {
    return m_list.frontEnd();
}

void Document::addStandardViews() {
    for (const StandardView& standard : standardViews()) {
        const KM_Viewport viewport =
            standardViewport(standard, KM_3dPoint::Origin, START_DISTANCE,
                             ViewState::default_width_px, ViewState::default_height_px);
        m_active_view = addView(standard.name, viewport).value();
    }
}

void Document::close() {
    m_is_open = false;
    closeAllViews();
    m_lights.close();
    m_sun.close();
    m_drawing->release();
    if (m_render_window.isOpen())
        frontEnd().renderWindowShown({});
    m_render_window.close();
    m_objects = ObjectTable();
    m_named_views.clear();
    m_edges.clear();
    *m_file_remainder = FileRemainder();
    m_saved_state.reset();
    m_object_copies.reset();
}

void Document::closeAllViews() {
    m_due_views.clear();
    m_due_frame_sizes.clear();
    m_due_active_view = nullptr;
    m_active_view = nullptr;
    for (std::unique_ptr<ViewState>& view : m_views) {
        view->close();
        m_closed_views.push_back(std::move(view));
    }
    m_views.clear();
}

ViewState* Document::findView(std::wstring_view name) const {
    const KM_wString wanted(name);
    const auto found = std::find_if(m_views.begin(), m_views.end(), [&](const auto& view) {
        return view->name().CompareNoCase(wanted) == 0;
    });
    return found == m_views.end() ? nullptr : found->get();
}

bool Document::activateView(std::wstring_view name) {
    ViewState* view = findView(name);
    if (view)
        m_active_view = view;
    return view != nullptr;
}

Result<void> Document::checkNewViewName(const KM_wString& name) const {
    const auto is_control = [](wchar_t character) { return character < L' ' || character == 0x7F; };
    if (name.IsEmpty() || std::ranges::any_of(name.View(), is_control))
        return Error{"A view needs a name, of characters that can be seen."};
    if (const ViewState* taken = findView(name.View()))
        return Error{"There is a view \"" + taken->name().ToUtf8() +
                     "\" already. Give the new one another name."};
    return {};
}

Result<ViewState*> Document::addView(const KM_wString& name, const KM_Viewport& viewport) {
    if (const auto checked = checkNewViewName(name); !checked)
        return checked.error();
    m_views.push_back(std::make_unique<ViewState>(*this, name, viewport));
    ViewState* view = m_views.back().get();
    view->setDisplayMode(standardModeFor(viewport));
    return view;
}

Result<void> Document::closeView(std::wstring_view name) {
    ViewState* view = findView(name);
    if (!view)
        return Error{"There is no view \"" + KM_wString(name).ToUtf8() + "\"."};
    if (std::ranges::find(m_due_views, view) != m_due_views.end())
        return {};
    if (m_views.size() - m_due_views.size() < 2)
        return Error{"The view \"" + view->name().ToUtf8() +
                     "\" is the document's last one and stays. Add another one first."};
    if (m_list.isCommandRunning())
        m_due_views.push_back(view);
    else
        closeNow(*view);
    return {};
}

void Document::activateWhenIdle(ViewState& view) {
    if (m_list.isCommandRunning())
        m_due_active_view = &view;
    else
        m_active_view = &view;
}

bool Document::setFrameSizeWhenIdle(ViewState& view, int width_px, int height_px) {
    if (!ViewState::isPictureSide(width_px) || !ViewState::isPictureSide(height_px))
        return false;
    m_due_frame_sizes[&view] = {width_px, height_px};
    if (!m_list.isCommandRunning())
        resizeDueFrames();
    return true;
}

void Document::settleViews() {
    if (m_due_active_view)
        m_active_view = std::exchange(m_due_active_view, nullptr);
    closeDueViews();
    resizeDueFrames();
}

void Document::closeDueViews() {
    for (ViewState* view : std::exchange(m_due_views, {}))
        closeNow(*view);
}

void Document::resizeDueFrames() {
    for (const auto& [view, size] : std::exchange(m_due_frame_sizes, {})) {
        const int old_width_px = view->frameWidth();
        const int old_height_px = view->frameHeight();
        const bool is_new = old_width_px != size.width_px || old_height_px != size.height_px;
        if (!view->isOpen() || !is_new)
            continue;
        view->setFrameSize(size.width_px, size.height_px);
        // A window that a person makes wider does not change the document.
        if (m_saved_state)
            m_saved_state->follow(*view, old_width_px, old_height_px);
    }
}

std::optional<StudiedPlace> Document::studiedPlace() const {
    const IQnZoetrixDynamicAccess* const access = Zoetrix_QuarnDynamicAccess();
    if (!m_studied_place || !access)
        return m_studied_place; // the record may be in the file, unread
    const auto agrees = acrossBorder([&] {
        const KM_3dmAnimationProperties& record = access->AnimationProperties(face());
        return m_studied_place->isAt(record.Latitude(), record.Longitude());
    });
    return !agrees || agrees.value() ? m_studied_place : std::nullopt;
}

bool Document::isModified() const {
    return isModified(savedStateOf(*this));
}

bool Document::isModified(const SavedState& now) const {
    return m_saved_state && !m_saved_state->covers(now);
}

void Document::markSaved() {
    m_saved_state = std::make_unique<SavedState>(savedStateOf(*this));
    ++m_save_count;
}

/// No table of objects has the revision of this state.
void Document::markUnsaved() {
    m_saved_state = std::make_unique<SavedState>();
}

void Document::markRecordSaved() {
    if (m_saved_state)
        m_saved_state->record = recordStateOf(*this);
}

void Document::closeNow(ViewState& view) {
    const auto place = std::ranges::find(m_views, &view, &std::unique_ptr<ViewState>::get);
    view.close();
    m_closed_views.push_back(std::move(*place));
    const auto behind = m_views.erase(place);
    if (m_active_view == &view)
        m_active_view = (behind == m_views.end() ? m_views.back() : *behind).get();
}

void Document::addModel(const ImportedModel& model) {
    if (m_objects.empty())
        m_units = model.units;
    for (const ImportedMesh& mesh : model.meshes)
        m_objects.addMesh(mesh.name, mesh.placed);
    for (const ImportedCurve& curve : model.curves)
        m_objects.addCurve(curve.name, std::make_unique<KM_PolylineCurve>(
                                           std::span(curve.points.Array(), curve.points.Count())));
    for (const KM_3dPoint& point : model.points)
        m_objects.addPoint(KM_wString(), point);
    for (const ImportedCamera& camera : model.cameras)
        m_named_views.push_back({camera.name, camera.viewport});
    for (const KM_Light& light : model.lights)
        m_lights.add(light);
    m_reading_notes = std::make_shared<const ReadingNotes>(ReadingNotes{model.up, model.warnings});
    fitTolerance();
}

void Document::fitTolerance() {
    KM_BoundingBox box;
    for (const auto& object : m_objects.objects())
        if (object->isInDrawableRange())
            box.Union(object->boundingBox());
    const double size = box.Diagonal().Length();
    if (size > 0.0)
        m_absolute_tolerance = std::min(m_absolute_tolerance, TOLERANCE_OF_SIZE * size);
}

MeshEdgeChoice Document::edgesOf(const KM_UUID& display_mode) const {
    const auto found = m_edges.find(display_mode);
    return found == m_edges.end() ? MeshEdgeChoice::standard : found->second;
}

void Document::setEdgesOf(const KM_UUID& display_mode, MeshEdgeChoice choice) {
    if (choice == MeshEdgeChoice::standard)
        m_edges.erase(display_mode);
    else
        m_edges[display_mode] = choice;
}

} // namespace quarn
