#pragma once

#include "host/share/film/module/AvPointers.h"

#include <string>

namespace quarn {

/// Filters through which frames go.
class FilterGraph {
public:
    /// @param description  as libavfilter reads it; its sources are named "buffer@in" and, where it
    ///                     has a second one, "buffer@palette", its end "buffersink@out"
    static Result<FilterGraph> make(const std::string& description);

    /// Hands a frame over; a null one ends the source.
    Result<void> send(AvPointer<AVFrame> frame);
    /// The one frame of the second source, whose end comes with it.
    Result<void> sendPalette(AvPointer<AVFrame> palette);
    /// @return the next frame that came through; null where there is none yet
    Result<AvPointer<AVFrame>> receive();

private:
    AvPointer<AVFilterGraph> m_graph;
    AVFilterContext* m_source = nullptr;
    AVFilterContext* m_palette = nullptr;
    AVFilterContext* m_end = nullptr;
};

/// The description of a source of frames.
/// @param name  "in" or "palette"
std::string sourceText(const char* name, int width, int height, const char* format);

/// A text as the value of a filter's option.
std::string escapedForFilter(const std::string& text);

} // namespace quarn
