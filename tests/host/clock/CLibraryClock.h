#pragma once

#include <chrono>
#include <cstdlib>
#include <ctime>
#include <string>

/// What the C library shows in a zone: the variable TZ is this object's as long as it lives.
class CLibraryClock {
public:
    explicit CLibraryClock(const std::string& zone) {
        if (const char* const before = std::getenv("TZ"))
            m_before = before, m_was_set = true;
        setenv("TZ", zone.c_str(), 1);
        tzset();
    }
    CLibraryClock(const CLibraryClock&) = delete;
    CLibraryClock& operator=(const CLibraryClock&) = delete;
    ~CLibraryClock() {
        if (m_was_set)
            setenv("TZ", m_before.c_str(), 1);
        else
            unsetenv("TZ");
        tzset();
    }

    std::tm at(std::chrono::sys_seconds utc) const {
        const std::time_t time = utc.time_since_epoch().count();
        std::tm shown{};
        localtime_r(&time, &shown);
        return shown;
    }

private:
    std::string m_before;
    bool m_was_set = false;
};
