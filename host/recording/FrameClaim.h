#pragma once

#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <utility>

namespace quarn {

/// Keeps other programs from doing the same at the same time, also those of other machines: a file
/// that only one of them can make, and that names the journal of who has made it. It holds as long
/// as that one is alive. Goes away with this.
class FrameClaim {
public:
    /// Who claims.
    struct Claimer {
        std::filesystem::path journal; ///< in the same folder
        /// Whether the writer of another journal, given by its name, may still be at work.
        std::function<bool(const std::string&)> is_alive;
    };
    /// @return nothing where another one that is alive has it; a claim, also where the disk takes
    /// no
    ///         such file: then nobody is kept out
    static std::optional<FrameClaim> take(const std::filesystem::path& file,
                                          const Claimer& claimer);
    FrameClaim(FrameClaim&& other) noexcept
        : m_file(std::exchange(other.m_file, {})), m_owner(std::move(other.m_owner)) {}
    FrameClaim& operator=(FrameClaim&& other) noexcept {
        std::swap(m_file, other.m_file);
        std::swap(m_owner, other.m_owner);
        return *this;
    }
    ~FrameClaim();

private:
    FrameClaim(std::filesystem::path file, std::string owner)
        : m_file(std::move(file)), m_owner(std::move(owner)) {}

    std::filesystem::path m_file; ///< empty: none
    std::string m_owner;          ///< what the file holds
};

/// The file of a claim on a frame.
std::string claimName(const std::string& animation, int frame);

} // namespace quarn
