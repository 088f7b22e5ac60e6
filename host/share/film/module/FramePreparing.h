#pragma once

#include "host/share/film/FilmModule.h"
#include "host/share/film/module/FilterGraph.h"

#include <optional>

namespace quarn {

/// Makes pictures as they are drawn into pictures as films have them: of their size, in their
/// pixels, with their captions.
class FramePreparing {
public:
    explicit FramePreparing(const FilmForm& form) : m_form(form) {}

    /// @param number  of the frame in the film; becomes its time
    Result<AvPointer<AVFrame>> prepare(const ImageView& picture, const std::string& caption,
                                       int number);

private:
    Result<void> begin(const ImageView& picture);
    Result<AvPointer<AVFrame>> frameOf(const ImageView& picture) const;
    std::string description() const;
    std::string captionFilter() const;

    FilmForm m_form;
    int m_width = 0; ///< of what goes into the filters
    int m_height = 0;
    std::optional<FilterGraph> m_filters;
};

} // namespace quarn
