#pragma once

#include "import/ReadingWatch.h"

#include <Message_ProgressIndicator.hxx>

#include <algorithm>
#include <atomic>

namespace quarn {

/// Tells who watches a reading how far the library is, and the library when they give up.
class CadProgress final : public Message_ProgressIndicator {
public:
    /// @param from, to  the part of the step "read" that this work is
    CadProgress(ReadingWatch& watch, double from, double to)
        : m_watch(watch), m_from(from), m_to(to) {}

    Standard_Boolean UserBreak() override { return m_given_up; }
    void Show(const Message_ProgressScope&, const Standard_Boolean) override {
        const double share = m_from + (m_to - m_from) * std::clamp(GetPosition(), 0.0, 1.0);
        if (!m_watch.goesOn(ReadingStep::read, share))
            m_given_up = true;
    }

private:
    ReadingWatch& m_watch;
    double m_from;
    double m_to;
    std::atomic<bool> m_given_up = false;
};

} // namespace quarn
