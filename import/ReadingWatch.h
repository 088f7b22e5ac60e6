#pragma once

namespace quarn {

/// The steps of reading a model file, one after the other.
enum class ReadingStep {
    read, ///< its bytes are understood
    made, ///< its meshes are made: placed, with normals
};

/// Who watches a model being read. Called from any thread, but never from two at once.
class ReadingWatch {
public:
    virtual ~ReadingWatch() = default;

    /// Told now and then, at least a few times a second in a long reading.
    /// @param share  of the step that is done, 0 to 1
    /// @return false when the person has given up: the reading ends soon, with an error
    virtual bool goesOn(ReadingStep step, double share) = 0;
};

} // namespace quarn
