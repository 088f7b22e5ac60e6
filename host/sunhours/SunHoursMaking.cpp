#include "host/sunhours/SunHoursMaking.h"

#include "engine/images/ImageFile.h"
#include "engine/scene/UnitLength.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentScene.h"
#include "host/sun/SunYears.h"
#include "host/sunhours/HourColors.h"
#include "host/sunhours/HoursPicture.h"
#include "host/sunhours/HoursSheet.h"
#include "host/sunhours/NumberFiles.h"
#include "host/sunhours/PlanView.h"
#include "host/sunhours/SunHoursPage.h"

namespace quarn {

namespace {

namespace fs = std::filesystem;

constexpr SheetText NO_SURFACE{L"%1 shows no surface that the sun could reach.", 42997};
constexpr SheetText NO_YEAR{L"The sun is known from %1 to %2 only. Give another year.", 42998};

/// Shares of the whole that its parts take; they go by the numbers of their points.
class Parts {
public:
    Parts(const SunWatch& watch, double points) : m_watch(watch), m_points(points) {}
    SunWatch next(double points) {
        const double first = m_done;
        m_done += points;
        return [this, first, points](double share) {
            return m_watch(std::min(1.0, (first + share * points) / m_points));
        };
    }

private:
    const SunWatch& m_watch;
    double m_points;
    double m_done = 0.0;
};

/// All that is found out before the first file is written.
struct Findings {
    SunHoursMap map;
    Image picture;
    std::vector<std::string> names;
    std::vector<ObjectHours> objects;
    std::optional<SurfaceGrid> grid;
    SunLight grid_light;
};

std::vector<std::string> namesOf(const Document& document, const SceneContent& content) {
    std::vector<std::string> names;
    for (const SceneMesh& mesh : content.meshes) {
        const DocumentObject* const object = document.objects().find(mesh.id);
        std::string name = object ? object->name.ToUtf8() : std::string();
        names.push_back(name.empty() ? "object " + std::to_string(names.size() + 1) : name);
    }
    return names;
}

Result<void> check(const SunHoursRequest& request, const DisplayScene& scene) {
    if (!scene.rays().root())
        return Error{SheetWords()(NO_SURFACE, {request.title})};
    for (const auto& day : {request.first_day, request.last_day})
        if (!isSunYear(static_cast<int>(day.year())))
            return Error{SheetWords()(
                NO_YEAR, {std::to_string(FIRST_SUN_YEAR), std::to_string(LAST_SUN_YEAR)})};
    return {};
}

/// @return nothing where the watch ended the work
std::optional<Findings> find(const DisplayScene& scene, const KM_Viewport& view,
                             const SunHoursRequest& request, const SunMoments& moments,
                             std::vector<std::string> names, std::optional<SurfaceGrid> grid,
                             const SunWatch& watch) {
    const double pixels = static_cast<double>(request.width_px) * request.height_px;
    const ObjectPoints spread = spreadPoints(scene);
    const double of_objects = static_cast<double>(spread.points.size());
    const double of_grid = grid ? static_cast<double>(grid->points.size()) : 0.0;
    Parts parts(watch, 1.2 * pixels + of_objects + of_grid);
    auto map = mapOf(scene, view, request, moments, parts.next(pixels));
    if (!map)
        return std::nullopt;
    auto picture = colouredMap(scene, view, request, moments, *map, parts.next(0.2 * pixels));
    if (!picture)
        return std::nullopt;
    Findings found{std::move(*map), std::move(*picture), std::move(names), {}, std::move(grid), {}};
    SunLight light;
    const std::vector<SunStep> steps = stepsOf(moments);
    if (!findSun(scene, spread.points, steps, false, parts.next(of_objects), light))
        return std::nullopt;
    for (const ObjectSpan& object : spread.objects) {
        found.objects.push_back(hoursOf(object, spread.points, light, request.threshold_hours));
        found.objects.back().name = found.names[object.mesh];
    }
    if (found.grid &&
        !findSun(scene, found.grid->points, steps, false, parts.next(of_grid), found.grid_light))
        return std::nullopt;
    return found;
}

Result<void> writeAll(const Document& document, const SunHoursRequest& request,
                      const SunMoments& moments, const fs::path& page_template,
                      const Findings& found, const KM_3dPoint& origin, SunHoursReport& report) {
    auto letters = Letters::read(programFont());
    if (!letters)
        return letters.error();
    const TextPainter text(std::move(letters.value()));
    report.files = filesOf(request);
    auto file = report.files.begin();
    const std::string unit = metresPerUnit(document.units()) == 1.0 ? "m2" : "";
    const std::string csv = objectsCsv(found.objects, request.threshold_hours, unit);
    Result<void> written = writeImageFile(*file++, sheetOf(found.picture, request, moments, text));
    if (written)
        written = writeHoursArray(*file++, found.map);
    if (written)
        written = writeFileAtomically(*file++, std::as_bytes(std::span(csv)));
    if (written)
        written = writeSunHoursPage(
            *file++, {request, moments, found.map, found.picture, found.names, page_template});
    if (written && found.grid)
        written =
            writeGrid(*file++, *found.grid, found.grid_light, origin, endOfScale(moments.hours));
    return written;
}

} // namespace

std::vector<fs::path> filesOf(const SunHoursRequest& request) {
    std::vector<fs::path> files;
    for (const char* const extension : {".png", ".npy", ".csv", ".html"})
        files.push_back(request.folder / (request.name + "-sunhours" + extension));
    if (request.grid_size > 0.0)
        files.push_back(request.folder / (request.name + "-sunhours.ply"));
    return files;
}

Result<SunHoursReport> writeSunHours(Document& document, const SunHoursRequest& request,
                                     const fs::path& page_template,
                                     const std::function<bool(double share)>& watch) {
    const auto built = document.drawing().scene();
    if (!built)
        return built.error();
    const DisplayScene& scene = built.value()->display();
    if (const auto checked = check(request, scene); !checked)
        return checked.error();
    std::optional<SurfaceGrid> grid;
    if (request.grid_size > 0.0) {
        auto cut = gridOfSurfaces(scene, request.grid_size);
        if (!cut)
            return cut.error();
        grid = std::move(cut.value());
    }
    const KM_Viewport view = request.is_plan
                                 ? planView(scene.surfaceBox(), request.width_px, request.height_px)
                                 : document.activeView().viewport();
    const SunMoments moments = momentsOf(request);
    SunHoursReport report;
    report.most_hours = moments.hours;
    report.steps = moments.moments.size();
    auto found = find(scene, view, request, moments, namesOf(document, built.value()->content()),
                      std::move(grid), watch);
    report.is_given_up = !found;
    if (!found)
        return report;
    const auto written =
        writeAll(document, request, moments, page_template, *found, scene.origin(), report);
    return written ? Result<SunHoursReport>(report) : written.error();
}

} // namespace quarn
