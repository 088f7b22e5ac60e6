#pragma once

#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Session.h"
#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/qncore.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <functional>
#include <initializer_list>
#include <optional>
#include <string>

using quarn::test::readFile;
using quarn::test::writeFile;

/// A front end without a person that lets a test look at the document meanwhile.
class WatchedFrontEnd final : public quarn::ScriptedFrontEnd {
public:
    void pumpEvents(unsigned milliseconds) override {
        if (while_waiting)
            while_waiting();
        ScriptedFrontEnd::pumpEvents(milliseconds);
    }

    /// Called whenever the host waits: once before the first frame that is shown or recorded, and
    /// at least once for every frame.
    std::function<void()> while_waiting;
};

/// A running host without a person, with the plug-in loaded, a fresh record and a new document.
class PlugInFixture : public ::testing::Test {
protected:
    PlugInFixture();
    /// @param plug_ins  a folder below the test plug-ins; empty for none
    explicit PlugInFixture(const std::string& plug_ins, const std::string& language = "C");

    CQuarnDoc& doc() { return session->document(); }
    /// The record that the plug-in keeps.
    KM_3dmAnimationProperties& record();
    /// The view of the document with this name.
    CQuarnView& view(const wchar_t* name);

    /// Queues answers of the person who is asked.
    void answer(std::initializer_list<std::wstring_view> answers);
    CQuarnCommand::result run(const KM_wString& line) { return session->runCommand(line.View()); }
    /// Calls the body while a script command runs, as asking is only possible then.
    void insideCommand(const std::function<void(CQuarnDoc&)>& body);

    /// Imports an OBJ file with this text.
    void importObj(const std::string& text);
    const KM_UUID objectId(const wchar_t* name);
    bool isHidden(const wchar_t* name);

    /// Places a view's camera, level.
    void placeCamera(const wchar_t* view_name, const KM_3dPoint& camera, const KM_3dPoint& target);
    /// Gives the record `frames` frames of a camera that moves along +X and looks along +Y.
    void setUpCameraFrames(int frames);
    /// Gives the record a sun study of `frames` frames.
    void setUpSunFrames(int frames);

    const std::wstring& printed() const { return front_end.printed(); }

    quarn::test::TempFolder folder;
    WatchedFrontEnd front_end;
    std::unique_ptr<quarn::Session> session;
};

/// The camera of frame k of setUpCameraFrames.
inline KM_3dPoint cameraOfFrame(int k) {
    return {static_cast<double>(k), -10.0, 2.0};
}
/// The target of frame k of setUpCameraFrames.
inline KM_3dPoint targetOfFrame(int k) {
    return {static_cast<double>(k), 0.0, 0.0};
}
/// The sun of frame k of setUpSunFrames.
inline KM_3dPoint sunOfFrame(int k) {
    return {0.6, 0.1 * k, 0.8};
}

/// A path in the form that the interface takes.
inline KM_wString wide(const std::filesystem::path& path) {
    return KM_wString::FromUtf8(path.string());
}

/// Whether a file begins as a JPEG file does.
bool isJpeg(const std::filesystem::path& file);

testing::AssertionResult near(const KM_3dPoint& a, const KM_3dPoint& b, double tolerance);
testing::AssertionResult near(const KM_3dVector& a, const KM_3dVector& b, double tolerance);
