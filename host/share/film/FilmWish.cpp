#include "host/share/film/FilmWish.h"

#include "ground/ModuleFile.h"
#include "ground/PartFile.h"
#include "ground/PathText.h"
#include "host/letters/Letters.h"
#include "sdk/qncore/QnLocalize.h"

#include <cerrno>
#include <cstring>

namespace quarn {

namespace {

namespace fs = std::filesystem;

constexpr ModuleFile MODULE = {
    "QuarnFilm.so", GET_FILM_MODULE_NAME,
    "libavformat-dev, libavcodec-dev, libavfilter-dev, libswscale-dev and libavutil-dev",
    "libavfilter8"};

template <class... Arguments> Error sentence(const wchar_t* format, const Arguments&... arguments) {
    return {KM_wString::FormatToString(format, arguments...).ToUtf8()};
}

Result<void> checkKind(const FilmWish& wish) {
    const FilmKindFacts* const kind = filmKindOf(wish.file);
    const KM_wString name = textFromPath(wish.file);
    if (!kind)
        return sentence(QnLocalizeString(L"%s is not written: no kind of film ends so. Give a file "
                                         L"that ends in .mp4, .webm, .gif, .webp or .apng.",
                                         42770),
                        name.Array());
    if (wish.frame_rate > kind->most_frames_a_second)
        return sentence(
            QnLocalizeString(L"%s is not written: such a film shows at most %d frames a second.",
                             42771),
            name.Array(), kind->most_frames_a_second);
    if (wish.quality > 0 && !kind->has_quality)
        return sentence(QnLocalizeString(L"%s is not written: such a film keeps every pixel as it "
                                         L"is, so no quality can be chosen for it.",
                                         42772),
                        name.Array());
    return {};
}

Result<void> checkFolder(const fs::path& file, const fs::path& folder) {
    std::error_code error;
    const KM_wString name = textFromPath(file);
    if (!fs::is_directory(folder, error))
        return sentence(
            QnLocalizeString(L"%s is not written: there is no folder %s. Make it first.", 42773),
            name.Array(), textFromPath(folder).Array());
    // Permissions alone do not tell: a folder may be on a file system that takes no files.
    if (!PartFile(folder, 0600).isOpen())
        return sentence(QnLocalizeString(L"%s is not written: nothing can be written into its "
                                         L"folder (%s). Choose another one.",
                                         42774),
                        name.Array(), KM_wString::FromUtf8(std::strerror(errno)).Array());
    return {};
}

Result<void> checkPlace(const FilmWish& wish, const fs::path& folder_to_come) {
    const fs::path folder = wish.file.has_parent_path() ? wish.file.parent_path() : ".";
    std::error_code error;
    const fs::file_status there = fs::status(wish.file, error);
    if (fs::exists(there) && (!wish.may_replace || !fs::is_regular_file(there)))
        return sentence(QnLocalizeString(L"%s is there already and is not replaced. Give another "
                                         L"name, or start the program with --overwrite.",
                                         42775),
                        textFromPath(wish.file).Array());
    const bool will_be_made =
        !folder_to_come.empty() &&
        (folder / "").lexically_normal() == (folder_to_come / "").lexically_normal();
    if (will_be_made && !fs::exists(folder, error))
        return {};
    return checkFolder(wish.file, folder);
}

Result<void> checkEncoder(const FilmWish& wish, const Result<const FilmModule*>& module) {
    const KM_wString name = textFromPath(wish.file);
    if (!module)
        return sentence(QnLocalizeString(L"%s is not written: %s.", 42776), name.Array(),
                        KM_wString::FromUtf8(module.message()).Array());
    const FilmKindFacts& kind = *filmKindOf(wish.file);
    const std::string missing = module.value()->missingEncoder(kind.kind);
    if (!missing.empty())
        return sentence(QnLocalizeString(L"%s is not written: the encoder %s is not installed. "
                                         L"Install the package %s, or make another kind of film.",
                                         42777),
                        name.Array(), KM_wString::FromUtf8(missing).Array(),
                        KM_wString::FromUtf8(kind.encoder_package).Array());
    std::error_code error;
    if (wish.has_caption && !fs::is_regular_file(programFont(), error))
        return sentence(QnLocalizeString(L"%s is not written: the font of its captions, %s, is not "
                                         L"there. Install Quarn with all its files.",
                                         42778),
                        name.Array(), textFromPath(programFont()).Array());
    return {};
}

} // namespace

Result<void> checkFilm(const FilmWish& wish, const Result<const FilmModule*>& module,
                       const fs::path& folder_to_come) {
    if (const auto checked = checkKind(wish); !checked)
        return checked;
    if (const auto checked = checkPlace(wish, folder_to_come); !checked)
        return checked;
    return checkEncoder(wish, module);
}

const Result<const FilmModule*>& filmModule() {
    static const Result<const FilmModule*> module = []() -> Result<const FilmModule*> {
        const auto opened = openModule(MODULE);
        if (!opened)
            return opened.error();
        return &reinterpret_cast<GetFilmModule>(opened.value())();
    }();
    return module;
}

} // namespace quarn
