#include "tests/zoetrix/PlugInFixture.h"

#include "zoetrix/plugin/ZoetrixPlugIn.h"

#include <cstdlib>
#include <fstream>
#include <iterator>

namespace {

std::function<void(CQuarnDoc&)> the_body;

/// Runs what a test gives it.
class TestBodyCommand final : public CQuarnScriptCommand {
public:
    KM_UUID CommandUUID() override {
        return {0xD1A3F0C7, 0x6E52, 0x4B1D, {0x90, 0x2F, 0x5C, 0x88, 0x1E, 0x47, 0xB3, 0x6A}};
    }
    const wchar_t* EnglishCommandName() override { return L"TestBody"; }
    result RunCommand(const CQuarnCommandContext& context) override {
        the_body(context.Document());
        return success;
    }
};

TestBodyCommand the_command;

quarn::SessionOptions optionsFor(const std::filesystem::path& folder, const std::string& plug_ins,
                                 const std::string& language) {
    quarn::SessionOptions options;
    if (!plug_ins.empty())
        options.plug_in_folders.push_back(std::filesystem::path(TEST_PLUGIN_DIR) / plug_ins);
    // The plug-in's objects are part of this program, and so are its texts.
    const std::filesystem::path sources = QUARN_SOURCE_DIR;
    options.locale_folders.push_back(sources / "host/locale");
    options.program_locale_folder = sources / "zoetrix/locale";
    options.language = language;
    options.documents_folder = folder;
    return options;
}

} // namespace

PlugInFixture::PlugInFixture() : PlugInFixture("") {}

PlugInFixture::PlugInFixture(const std::string& plug_ins, const std::string& language)
    : session(std::make_unique<quarn::Session>(front_end,
                                               optionsFor(folder.path(), plug_ins, language))) {
    ZoetrixPlugIn().SetAnimationProperties(doc(), KM_3dmAnimationProperties());
    const quarn::PlugInLoad load = session->adoptProgramPlugIn();
    EXPECT_TRUE(load.ok()) << load.message;
}

KM_3dmAnimationProperties& PlugInFixture::record() {
    return ZoetrixPlugIn().AnimationPropertiesForWrite(doc());
}

CQuarnView& PlugInFixture::view(const wchar_t* name) {
    KM_SimpleArray<CQuarnView*> views;
    doc().GetViewList(views, true, true);
    for (CQuarnView* candidate : views)
        if (KM_wString(candidate->MainViewport().Name()) == name)
            return *candidate;
    ADD_FAILURE() << "no view " << KM_wString(name).ToUtf8();
    return *views[0];
}

void PlugInFixture::answer(std::initializer_list<std::wstring_view> answers) {
    for (const std::wstring_view text : answers)
        front_end.addAnswer(text);
}

void PlugInFixture::insideCommand(const std::function<void(CQuarnDoc&)>& body) {
    bool was_called = false;
    the_body = [&](CQuarnDoc& document) {
        was_called = true;
        body(document);
    };
    EXPECT_EQ(CQuarnCommand::success, run(L"TestBody"));
    EXPECT_TRUE(was_called);
    the_body = nullptr;
}

void PlugInFixture::importObj(const std::string& text) {
    const std::filesystem::path file = folder.path() / "model.obj";
    writeFile(file, text);
    ASSERT_EQ(CQuarnCommand::success, run(L"Import \"" + wide(file) + L"\"")) << "import";
}

const KM_UUID PlugInFixture::objectId(const wchar_t* name) {
    const CQuarnObject* object = doc().FindObjectByName(name);
    EXPECT_TRUE(object) << KM_wString(name).ToUtf8();
    return object ? object->Id() : KM_nil_uuid;
}

bool PlugInFixture::isHidden(const wchar_t* name) {
    const CQuarnObject* object = doc().FindObjectByName(name);
    EXPECT_TRUE(object) << KM_wString(name).ToUtf8();
    return object && object->IsHidden();
}

void PlugInFixture::placeCamera(const wchar_t* view_name, const KM_3dPoint& camera,
                                const KM_3dPoint& target) {
    EXPECT_TRUE(
        view(view_name).MainViewport().SetTargetAndCameraLocation(target, camera, true, true));
}

void PlugInFixture::setUpCameraFrames(int frames) {
    KM_3dmAnimationProperties& props = record();
    props.SetCaptureType(KM_3dmAnimationProperties::turntable);
    props.SetViewportName(L"Perspective");
    props.SetHtmlFilename(L"Walk");
    props.SetFrameCount(frames);
    props.CameraPoints().Empty();
    props.TargetPoints().Empty();
    for (int k = 0; k < frames; ++k) {
        props.CameraPoints().Append(cameraOfFrame(k));
        props.TargetPoints().Append(targetOfFrame(k));
    }
}

void PlugInFixture::setUpSunFrames(int frames) {
    setUpCameraFrames(frames);
    KM_3dmAnimationProperties& props = record();
    props.SetCaptureType(KM_3dmAnimationProperties::one_day_sun);
    for (int k = 0; k < frames; ++k) {
        props.CameraPoints()[k] = sunOfFrame(k);
        props.TargetPoints()[k] = KM_3dPoint::Origin;
    }
}

bool isJpeg(const std::filesystem::path& file) {
    return readFile(file).starts_with("\xFF\xD8\xFF");
}

testing::AssertionResult near(const KM_3dPoint& a, const KM_3dPoint& b, double tolerance) {
    if (a.DistanceTo(b) <= tolerance)
        return testing::AssertionSuccess();
    return testing::AssertionFailure() << "(" << a.x << ", " << a.y << ", " << a.z << ") is not ("
                                       << b.x << ", " << b.y << ", " << b.z << ")";
}

testing::AssertionResult near(const KM_3dVector& a, const KM_3dVector& b, double tolerance) {
    return near(KM_3dPoint(a), KM_3dPoint(b), tolerance);
}
