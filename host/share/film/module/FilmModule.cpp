#include "host/share/film/FilmModule.h"

#include "host/share/film/module/EncodedFilm.h"
#include "host/share/film/module/PaletteFilm.h"

#include <exception>

extern "C" {
#include <libavutil/log.h>
}

namespace quarn {

namespace {

/// Lets no exception out: memory may lack anywhere.
template <class Value, class Work> Result<Value> guarded(const Work& work) {
    try {
        return work();
    } catch (const std::exception& failure) {
        return Error{failure.what()};
    }
}

class GuardedFilm final : public FilmWriter {
public:
    explicit GuardedFilm(std::unique_ptr<FilmWriter> film) : m_film(std::move(film)) {}

    Result<void> add(const ImageView& picture, const std::string& caption) override {
        return guarded<void>([&] { return m_film->add(picture, caption); });
    }
    Result<void> finish() override {
        return guarded<void>([&] { return m_film->finish(); });
    }
    int framesEncoded() const override { return m_film->framesEncoded(); }
    void endSoon() override { m_film->endSoon(); }

private:
    std::unique_ptr<FilmWriter> m_film;
};

using OpenedFilm = Result<std::unique_ptr<FilmWriter>>;

OpenedFilm openFilm(const FilmForm& form, const std::filesystem::path& file) {
    if (form.kind == FilmKind::gif)
        return PaletteFilm::open(form, file);
    auto stream = FilmStream::open(form, file);
    if (!stream)
        return stream.error();
    return std::unique_ptr<FilmWriter>(new EncodedFilm(form, std::move(stream.value())));
}

class LibraryModule final : public FilmModule {
public:
    LibraryModule() { av_log_set_level(AV_LOG_QUIET); } // it writes to the person's terminal

    std::string missingEncoder(FilmKind kind) const override {
        const char* const encoder = recipeOf(kind).encoder;
        return avcodec_find_encoder_by_name(encoder) ? "" : encoder;
    }

    OpenedFilm open(const FilmForm& form, const std::filesystem::path& file) const override {
        return guarded<std::unique_ptr<FilmWriter>>([&]() -> OpenedFilm {
            auto film = openFilm(form, file);
            if (!film)
                return film;
            return std::unique_ptr<FilmWriter>(new GuardedFilm(std::move(film.value())));
        });
    }
};

} // namespace

} // namespace quarn

extern "C" __attribute__((visibility("default"))) const quarn::FilmModule& quarnFilmModule() {
    static const quarn::LibraryModule module;
    return module;
}
