#include "host/front_end/FrontEnd.h"

namespace quarn {

DialogEvents::~DialogEvents() = default;

DialogWindow::~DialogWindow() = default;

FrontEnd::~FrontEnd() = default;

void FrontEnd::recordingBegun(const RecordingStart&) {}

void FrontEnd::recordingEnded(const RecordingReport&) {}

void FrontEnd::warn(std::wstring_view text) {
    print(std::wstring(text) + L"\n");
}

void FrontEnd::sharedFileProgress(const std::filesystem::path&, double) {}

void FrontEnd::sharedFileEnded(const SharedFileReport& report) {
    print(std::wstring(report.text.Array()) + L"\n");
}

void FrontEnd::pictureRendered(double) {}

void FrontEnd::modelRead(const std::filesystem::path&, ModelStep, double) {}

std::unique_ptr<DialogWindow> FrontEnd::makeDialog(const DialogTemplate&, HWND) {
    return nullptr;
}

std::optional<Place> FrontEnd::chooseLocation(std::wstring_view, const Place&) {
    return std::nullopt;
}

FileChoice FrontEnd::chooseFile(const FileQuestion&) {
    return {};
}

std::optional<ModelUp> FrontEnd::chooseUpAxis(const UpAxisQuestion&) {
    return std::nullopt;
}

void FrontEnd::viewShown(CQuarnView&, const ShownPicture&) {}

void FrontEnd::renderWindowShown(const ShownPicture&) {}

} // namespace quarn
