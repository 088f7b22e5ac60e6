#include "sdk/qncore/QnDib.h"

#include "engine/images/ImageFile.h"
#include "ground/PathText.h"
#include "host/app/Application.h"

CQuarnDib::CQuarnDib() : m_image(std::make_unique<quarn::Image>()) {}
CQuarnDib::~CQuarnDib() = default;
CQuarnDib::CQuarnDib(CQuarnDib&& other) noexcept = default;
CQuarnDib& CQuarnDib::operator=(CQuarnDib&& other) noexcept = default;

int CQuarnDib::Width() const {
    return m_image ? m_image->width : 0;
}

int CQuarnDib::Height() const {
    return m_image ? m_image->height : 0;
}

KM_Color CQuarnDib::Pixel(int x, int y) const {
    if (x < 0 || y < 0 || x >= Width() || y >= Height())
        return {};
    const auto bytes = m_image->pixel(x, y);
    return {bytes[0], bytes[1], bytes[2], bytes[3]};
}

bool CQuarnDib::WriteToFile(const wchar_t* path, int) const {
    quarn::Application* application = quarn::Application::forCall("CQuarnDib::WriteToFile");
    if (!application || !path || !m_image)
        return false;
    const std::filesystem::path file = quarn::pathFromText(path);
    if (!application->mayWrite(file))
        return false;
    if (application->passesOver(file))
        return true;
    const auto written = quarn::writeImageFile(file, *m_image, application->protection(),
                                               application->jpegQuality());
    if (written)
        application->pictureWritten(file, *m_image);
    else
        application->tell(written.message());
    return written.ok();
}

quarn::Image& CQuarnDib::Image() {
    if (!m_image)
        m_image = std::make_unique<quarn::Image>();
    return *m_image;
}

const quarn::Image& CQuarnDib::Image() const {
    static const quarn::Image no_picture; // for a picture that was moved away
    return m_image ? *m_image : no_picture;
}
