#pragma once

#include "kelmar/KM_Color.h"
#include "sdk/qncore/QnExport.h"

#include <memory>

namespace quarn {
struct Image;
}

/// A picture in memory.
class QNCORE_API CQuarnDib {
public:
    /// A picture of no size.
    CQuarnDib();
    ~CQuarnDib();
    CQuarnDib(CQuarnDib&&) noexcept;
    CQuarnDib& operator=(CQuarnDib&&) noexcept;

    int Width() const;  ///< pixels
    int Height() const; ///< pixels
    /// The pixel x from the left and y from the top, from 0; black outside the picture.
    KM_Color Pixel(int x, int y) const;

    /// Writes the picture to a file whose extension (jpg, jpeg, png, bmp or tga, in any case) says
    /// the format. The file appears whole or not at all.
    /// @param flags  0; no other value has a meaning
    /// @return false for a picture of no size, an unknown extension, and a file that cannot be
    ///         written; the reason is shown on the command line
    bool WriteToFile(const wchar_t* path, int flags) const;

    /// The host's view of the pixels.
    quarn::Image& Image();
    const quarn::Image& Image() const;

private:
    std::unique_ptr<quarn::Image> m_image;
};
