#pragma once

#include "host/app/Application.h"
#include "host/document/Document.h"
#include "tests/zoetrix/fixtures/PlugInFixture.h"

#include <nlohmann/json.hpp>

namespace quarn::test {

using Json = nlohmann::json;

/// A roof, a view of 64 by 48 pixels in wireframe, and animations of it whose camera is exported.
class CameraFixture : public PlugInFixture {
protected:
    void SetUp() override;

    Document& document() { return Document::of(doc()); }
    ViewState& perspective() { return *document().findView(L"Perspective"); }
    void runAll(std::initializer_list<const wchar_t*> lines);
    /// Makes a curve, or puts another one in the place of the one of this name.
    void makeCurve(const std::string& name, const std::string& points, bool replaces = false);
    /// A turntable in name, whose cameras are these; all look at the origin.
    void setUpCameras(const KM_3dPointArray& cameras);

    /// Records the animation, and gives the camera of each frame.
    std::vector<KM_Viewport> recorded();

    CQuarnCommand::result exportTo(const std::filesystem::path& file, const wchar_t* rate = L"");
    /// What ExportCamera writes into such a file.
    std::string exported(const std::string& name, const wchar_t* rate = L"");
    Json exportedJson() { return Json::parse(exported("camera.json")); }
    std::string said() const { return KM_wString(printed()).ToUtf8(); }
};

KM_3dPoint pointOf(const Json& list);

/// Whether two points, or directions, are the same but for this part of their size.
testing::AssertionResult alike(const KM_3dPoint& a, const KM_3dPoint& b, double relative);

/// That the frames of an exported file have these cameras, to a relative 1e-12.
void expectCameras(const std::vector<KM_Viewport>& cameras, const Json& track);

} // namespace quarn::test
