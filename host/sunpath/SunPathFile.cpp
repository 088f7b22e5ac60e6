#include "host/sunpath/SunPathFile.h"

#include "engine/images/ImageFile.h"
#include "ground/AtomicFile.h"
#include "ground/PathText.h"
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

Result<void> writePicture(const SunPathWish& wish, const std::filesystem::path& file) {
    constexpr double SCALE = 2; // 250 dots an inch, where one disk fills the width of A4
    const auto letters = Letters::read(programFont());
    if (!letters)
        return Error{textFromPath(file).ToUtf8() + ": its letters cannot be drawn. " +
                     letters.message() + " A file that ends in .svg needs no font."};
    const Drawing drawing = sunPathDiagram(wish, SheetWords(letters.value()));
    return writeImageFile(file, pictureOf(drawing, SCALE, letters.value()));
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
    if (endingOf(file) == ".png")
        return writePicture(wish, file);
    const std::string text = svgText(sunPathDiagram(wish, SheetWords()));
    return writeFileAtomically(file, std::as_bytes(std::span(text)));
}

} // namespace quarn
