#include "import/assembly/PolylineChains.h"

#include <array>
#include <cstddef>
#include <deque>
#include <map>

namespace quarn {
namespace {

using Place = std::array<double, 3>;

Place placeOf(const KM_3dPoint& p) {
    return {p.x + 0.0, p.y + 0.0, p.z + 0.0};
}

using Run = std::deque<KM_3dPoint>;

std::vector<Run> runsOf(std::span<const LineSegment> segments) {
    std::vector<Run> runs;
    for (const auto& [from, to] : segments) {
        if (from == to) {
            continue;
        }
        const bool follows = !runs.empty() && runs.back().back() == from &&
                             runs.back().front() != runs.back().back();
        if (!follows) {
            runs.push_back({from});
        }
        runs.back().push_back(to);
    }
    return runs;
}

class RunJoining {
public:
    explicit RunJoining(std::vector<Run> runs) : m_runs(std::move(runs)), m_used(m_runs.size()) {
        for (std::size_t i = 0; i < m_runs.size(); ++i) {
            if (!isClosed(m_runs[i])) {
                m_ends[placeOf(m_runs[i].front())].push_back(i);
                m_ends[placeOf(m_runs[i].back())].push_back(i);
            }
        }
    }

    std::vector<KM_3dPointArray> join() {
        std::vector<KM_3dPointArray> polylines;
        for (std::size_t i = 0; i < m_runs.size(); ++i) {
            if (!m_used[i]) {
                polylines.push_back(chainFrom(i));
            }
        }
        return polylines;
    }

private:
    static constexpr std::size_t none = static_cast<std::size_t>(-1);

    static bool isClosed(const Run& run) { return run.front() == run.back(); }

    /// The unused run that alone meets `place` besides the chain that ends there.
    std::size_t continuationAt(const KM_3dPoint& place) const {
        const auto found = m_ends.find(placeOf(place));
        if (found == m_ends.end() || found->second.size() != 2) {
            return none;
        }
        for (const std::size_t run : found->second) {
            if (!m_used[run]) {
                return run;
            }
        }
        return none;
    }

    KM_3dPointArray chainFrom(std::size_t first) {
        m_used[first] = true;
        Run chain = std::move(m_runs[first]);
        while (!isClosed(chain)) {
            const std::size_t next = continuationAt(chain.back());
            if (next == none) {
                break;
            }
            append(chain, next);
        }
        while (!isClosed(chain)) {
            const std::size_t previous = continuationAt(chain.front());
            if (previous == none) {
                break;
            }
            prepend(chain, previous);
        }
        KM_3dPointArray points;
        for (const KM_3dPoint& p : chain) {
            points.Append(p);
        }
        return points;
    }

    void append(Run& chain, std::size_t next) {
        m_used[next] = true;
        const Run& run = m_runs[next];
        if (run.front() == chain.back()) {
            chain.insert(chain.end(), run.begin() + 1, run.end());
        } else {
            chain.insert(chain.end(), run.rbegin() + 1, run.rend());
        }
    }

    void prepend(Run& chain, std::size_t previous) {
        m_used[previous] = true;
        const Run& run = m_runs[previous];
        if (run.back() == chain.front()) {
            chain.insert(chain.begin(), run.begin(), run.end() - 1);
        } else {
            chain.insert(chain.begin(), run.rbegin(), run.rend() - 1);
        }
    }

    std::vector<Run> m_runs;
    std::vector<bool> m_used;
    std::map<Place, std::vector<std::size_t>> m_ends;
};

} // namespace

std::vector<KM_3dPointArray> joinSegments(std::span<const LineSegment> segments) {
    return RunJoining(runsOf(segments)).join();
}

} // namespace quarn
