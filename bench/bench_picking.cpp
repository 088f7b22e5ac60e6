// What a movement of the mouse costs: the object and the point under it in a mesh of a million
// triangles beside a thousand curves, beside drawing the view, and whether a document of ten
// thousand objects was modified.

#include "bench/Hills.h"
#include "bench/Timing.h"
#include "host/document/DocumentList.h"
#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/ViewPicking.h"
#include "kelmar/KM_PolylineCurve.h"

#include <cstdio>

namespace {

/// The least that one of so many calls took.
template <class Function> double bestOf(int calls, const Function& function) {
    double best_ms = 1e9;
    for (int i = 0; i < calls; ++i)
        bench::keepBest(best_ms, function);
    return best_ms;
}

void addCurves(quarn::Document& document, int count) {
    for (int i = 0; i < count; ++i) {
        KM_3dPointArray points;
        for (int k = 0; k < 100; ++k)
            points.Append({k - 50.0, 0.1 * i - 50.0, 6.0 + 0.01 * ((i + k) % 7)});
        document.objects().addCurve(
            L"Curve", std::make_unique<KM_PolylineCurve>(
                          std::span(points.Array(), static_cast<std::size_t>(points.Count()))));
    }
}

} // namespace

int main() {
    quarn::ScriptedFrontEnd front_end;
    quarn::DocumentList list(front_end);
    quarn::Document& document = list.openNew();
    document.objects().addMesh(L"Hills", {bench::makeHills(708)});
    CQuarnView& view = document.activeView().face();
    int at = 0;
    const auto pick = [&] {
        at = (at + 97) % 700;
        if (!quarn::objectAt(view, 300.0 + at, 360.0))
            bench::fail("The mouse was to be on the hills.");
    };
    std::printf("scene of 1 M triangles and the first pick %8.3f ms\n", bestOf(1, pick));
    std::printf("object under the mouse                    %8.3f ms\n", bestOf(50, pick));
    std::printf("point under the mouse                     %8.3f ms\n", bestOf(50, [&] {
                    at = (at + 97) % 700;
                    quarn::pointAt(view, 300.0 + at, 360.0);
                }));
    std::printf("drawing the view, 1280 by 720             %8.3f ms\n",
                bestOf(5, [&] { view.Redraw(); }));
    addCurves(document, 1000);
    pick();
    std::printf("object, with 1000 curves of 100 points    %8.3f ms\n", bestOf(50, pick));
    for (int i = 0; i < 10000; ++i)
        document.objects().addPoint(L"Point", {1.0 * i, 0.0, 0.0});
    document.markSaved();
    std::printf("modified? with 11001 objects              %8.3f ms\n",
                bestOf(20, [&] { (void)document.isModified(); }));
    return 0;
}
