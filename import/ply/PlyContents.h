#pragma once

#include "import/ModelReading.h"
#include "import/ReadingProgress.h"
#include "import/ply/PlyBody.h"

#include <tbb/parallel_for.h>

#include <mutex>
#include <span>
#include <string>
#include <string_view>

namespace quarn {

/// The file in hand, and what has been found wrong with it, by several threads at once.
class PlyContents {
public:
    PlyContents(const ModelReading& reading, std::string_view file, PlyHeader header,
                std::vector<PlyPart> parts);

    const PlyHeader& header() const { return m_header; }

    /// Calls `read` with the parts that hold elements of a kind, from several threads; once
    /// something is wrong, only with those that stand before it.
    template <class Read> void readParts(std::size_t kind, const Read& read) {
        const std::span<const PlyPart> parts = partsOf(kind);
        tbb::parallel_for(std::size_t{0}, parts.size(), [&](std::size_t i) {
            if (isWanted(parts[i].bytes.data()))
                read(parts[i], i);
        });
    }
    std::size_t countParts(std::size_t kind) const { return partsOf(kind).size(); }

    /// Counts a part as read.
    void finish(const PlyPart& part);
    /// Notes what is wrong with an element of a part, a part of a sentence without its subject.
    void fail(const PlyPart& part, std::uint64_t element, const char* place, std::string_view why);
    /// The same for what belongs to no element: a whole part of a sentence.
    void fail(const char* place, std::string why);
    void fail(std::string why) { fail(m_file.data(), std::move(why)); }

    /// The part of a sentence for what stands first in the file of all that is wrong; empty where
    /// nothing is.
    std::string why() const { return m_why; }

    ReadingBudget& budget() const { return m_reading.budget; }

private:
    std::span<const PlyPart> partsOf(std::size_t kind) const;
    bool isWanted(const char* place);

    const ModelReading& m_reading;
    std::string_view m_file;
    PlyHeader m_header;
    std::vector<PlyPart> m_parts;
    ReadingProgress m_progress;
    std::mutex m_failing;
    const char* m_fault = nullptr; ///< where the first one is; null: there is none
    std::string m_why;
};

} // namespace quarn
