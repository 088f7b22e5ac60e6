#include "host/sunpath/SunPathFile.h"

#include "engine/images/ImageFile.h"
#include "ground/AtomicFile.h"
#include "ground/ModuleFile.h"
#include "host/sunpath/DrawingPicture.h"
#include "host/sunpath/SvgText.h"

#include <algorithm>

namespace quarn {
namespace {

std::string endingOf(const std::filesystem::path& file) {
    std::string ending = file.extension().native();
    std::ranges::transform(ending, ending.begin(), [](char letter) {
        return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
    });
    return ending;
}

Result<void> writePicture(const Drawing& drawing, const std::filesystem::path& file) {
    constexpr double SCALE = 2; // 250 dots an inch, where one disk fills the width of A4
    const auto font = installedTree() / "share" / "quarn" / "fonts" / "DejaVuSans.ttf";
    const auto picture = pictureOf(drawing, SCALE, font);
    if (!picture)
        return Error{file.native() + ": its letters cannot be drawn. " + picture.message() +
                     " A file that ends in .svg needs no font."};
    return writeImageFile(file, picture.value());
}

} // namespace

std::optional<std::string> whyDiagramIsRefused(const std::filesystem::path& file) {
    if (endingOf(file) == ".svg" || endingOf(file) == ".png")
        return std::nullopt;
    return file.native() + " has no ending that a diagram can have: give a file that ends in .svg "
                           "or .png.";
}

Result<void> writeSunPathDiagram(const SunPathWish& wish, const std::filesystem::path& file) {
    if (const auto refusal = whyDiagramIsRefused(file))
        return Error{*refusal};
    const Drawing drawing = sunPathDiagram(wish);
    if (endingOf(file) == ".png")
        return writePicture(drawing, file);
    const std::string text = svgText(drawing);
    return writeFileAtomically(file, std::as_bytes(std::span(text)));
}

} // namespace quarn
