#pragma once

#include <span>
#include <vector>

namespace quarn {

/// Numbers of frames. Frames that follow each other take one entry, so that a whole recording does.
class FrameSet {
public:
    struct Range {
        int first;
        int last; ///< not before `first`

        friend bool operator==(const Range&, const Range&) = default;
    };

    FrameSet() = default;
    /// The frames from 0 up to, and without, `count`.
    static FrameSet firstOf(int count);

    void add(int frame) { add(Range{frame, frame}); }
    void add(const Range& range);
    void add(const FrameSet& frames);

    bool has(int frame) const;
    bool isEmpty() const { return m_ranges.empty(); }
    int count() const;
    /// In rising order; none touches the next one.
    std::span<const Range> ranges() const { return m_ranges; }

    friend bool operator==(const FrameSet&, const FrameSet&) = default;

private:
    std::vector<Range> m_ranges;
};

} // namespace quarn
