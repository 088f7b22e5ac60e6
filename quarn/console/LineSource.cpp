#include "quarn/console/LineSource.h"

namespace quarn::program {

void LineSource::setIdleWork(std::function<void()> work, std::chrono::milliseconds between) {
    m_idle_work = std::move(work);
    m_between = between;
}

InputByte LineSource::waitForByte(int descriptor) const {
    for (;;) {
        const InputByte input = readInputByte(descriptor, m_idle_work ? m_between : NO_END);
        if (input.kind != InputByte::Kind::late)
            return input;
        m_idle_work();
    }
}

} // namespace quarn::program
