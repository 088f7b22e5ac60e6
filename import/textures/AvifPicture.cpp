#include "import/textures/AvifPicture.h"

#include <avif/avif.h>
#include <dlfcn.h>

#include <cstring>
#include <memory>
#include <string>

namespace quarn {

namespace {

using Bytes = std::span<const std::uint8_t>;

/// The functions of the library. It brings five codecs along, which would take five milliseconds of
/// each start of each program, so it is opened when such a picture comes.
struct Library {
    decltype(&avifVersion) version = nullptr;
    decltype(&avifDecoderCreate) create = nullptr;
    decltype(&avifDecoderDestroy) destroy = nullptr;
    decltype(&avifDecoderSetIOMemory) setMemory = nullptr;
    decltype(&avifDecoderParse) parse = nullptr;
    decltype(&avifDecoderNextImage) nextImage = nullptr;
    decltype(&avifRGBImageSetDefaults) setDefaults = nullptr;
    decltype(&avifImageYUVToRGB) toRgb = nullptr;
};

template <class Function> bool find(void* library, const char* name, Function& function) {
    function = reinterpret_cast<Function>(dlsym(library, name));
    return function != nullptr;
}

/// Whether the library has the layouts of the header that this was built with: versions before 1
/// change them with the second number.
bool fitsHeader(const std::string& version) {
    const std::string begin =
        std::to_string(AVIF_VERSION_MAJOR) + "." + std::to_string(AVIF_VERSION_MINOR) + ".";
    return version.starts_with(begin);
}

Library openLibrary() {
    void* const file = dlopen("libavif.so." QUARN_AVIF_SONAME, RTLD_NOW | RTLD_LOCAL);
    Library library;
    const bool is_whole = file != nullptr && find(file, "avifVersion", library.version) &&
                          find(file, "avifDecoderCreate", library.create) &&
                          find(file, "avifDecoderDestroy", library.destroy) &&
                          find(file, "avifDecoderSetIOMemory", library.setMemory) &&
                          find(file, "avifDecoderParse", library.parse) &&
                          find(file, "avifDecoderNextImage", library.nextImage) &&
                          find(file, "avifRGBImageSetDefaults", library.setDefaults) &&
                          find(file, "avifImageYUVToRGB", library.toRgb) &&
                          fitsHeader(library.version());
    return is_whole ? library : Library{};
}

/// Opened by the first call; without a function where it is not installed.
const Library& library() {
    static const Library opened = openLibrary();
    return opened;
}

struct FreeDecoder {
    void operator()(avifDecoder* decoder) const { library().destroy(decoder); }
};

using Decoder = std::unique_ptr<avifDecoder, FreeDecoder>;

/// Null where the file is damaged.
Decoder decoderOf(Bytes file) {
    constexpr std::uint32_t MOST_PIXELS = 64U << 20;
    Decoder decoder(library().create());
    if (decoder == nullptr)
        return nullptr;
    decoder->imageSizeLimit = MOST_PIXELS;
    decoder->strictFlags = AVIF_STRICT_DISABLED; // as browsers read them
    const bool is_read =
        library().setMemory(decoder.get(), file.data(), file.size()) == AVIF_RESULT_OK &&
        library().parse(decoder.get()) == AVIF_RESULT_OK;
    return is_read ? std::move(decoder) : nullptr;
}

bool isAvif(Bytes file) {
    const bool is_marked = file.size() >= 12 && (std::memcmp(&file[4], "ftypavif", 8) == 0 ||
                                                 std::memcmp(&file[4], "ftypavis", 8) == 0);
    return is_marked && library().create != nullptr;
}

std::optional<PictureSize> sizeOfAvif(Bytes file) {
    const Decoder decoder = decoderOf(file);
    if (decoder == nullptr)
        return std::nullopt;
    return PictureSize{decoder->image->width, decoder->image->height};
}

bool decodeAvif(Bytes file, std::span<std::uint8_t> rgba) {
    const Decoder decoder = decoderOf(file);
    if (decoder == nullptr || library().nextImage(decoder.get()) != AVIF_RESULT_OK)
        return false;
    const avifImage& image = *decoder->image;
    if (PictureSize{image.width, image.height}.bytes() != rgba.size())
        return false;
    avifRGBImage target{};
    library().setDefaults(&target, &image);
    target.format = AVIF_RGB_FORMAT_RGBA;
    target.depth = 8;
    target.pixels = rgba.data();
    target.rowBytes = 4 * image.width;
    return library().toRgb(&image, &target) == AVIF_RESULT_OK;
}

} // namespace

const PictureFormat AVIF_PICTURES{isAvif, sizeOfAvif, decodeAvif};

} // namespace quarn
