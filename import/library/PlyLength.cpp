#include "import/library/PlyLength.h"

#include "import/library/PlyHeader.h"

#include <algorithm>
#include <optional>

namespace quarn {
namespace {

/// Steps over `count` elements with lists; false when the file ends before them.
class ListWalk {
public:
    ListWalk(std::istream& file, bool big_endian, std::uint64_t left)
        : m_file(file), m_big_endian(big_endian), m_left(left) {}

    bool skip(const PlyElement& element) {
        if (!element.hasList()) {
            const std::uint64_t bytes = element.count * element.leastBytes(false);
            return skipBytes(bytes);
        }
        for (std::uint64_t i = 0; i < element.count; ++i) {
            if (!skipOne(element)) {
                return false;
            }
        }
        return true;
    }

private:
    bool skipOne(const PlyElement& element) {
        for (const PlyProperty& p : element.properties) {
            std::uint64_t values = 1;
            if (p.count_bytes > 0 && !readCount(p.count_bytes, values)) {
                return false;
            }
            if (!skipBytes(values * static_cast<std::uint64_t>(p.value_bytes))) {
                return false;
            }
        }
        return true;
    }

    bool readCount(int bytes, std::uint64_t& count) {
        if (bytes > 4 || m_left < static_cast<std::uint64_t>(bytes)) {
            return false;
        }
        count = 0;
        for (int i = 0; i < bytes; ++i) {
            const auto byte = static_cast<std::uint64_t>(m_file.rdbuf()->sbumpc() & 0xFF);
            count = m_big_endian ? count << 8 | byte : count | byte << (8 * i);
        }
        m_left -= static_cast<std::uint64_t>(bytes);
        return true;
    }

    bool skipBytes(std::uint64_t bytes) {
        if (bytes > m_left) {
            return false;
        }
        m_left -= bytes;
        if (bytes > 64) {
            m_file.seekg(static_cast<std::streamoff>(bytes), std::ios::cur);
            return m_file.good();
        }
        for (std::uint64_t i = 0; i < bytes; ++i) {
            m_file.rdbuf()->sbumpc();
        }
        return true;
    }

    std::istream& m_file;
    bool m_big_endian;
    std::uint64_t m_left;
};

std::string endsBefore(const PlyElement& element) {
    return "it claims " + std::to_string(element.count) + " elements of kind '" + element.name +
           "' but ends before them";
}

} // namespace

std::string whyBadPly(std::istream& file, std::uint64_t size) {
    std::string magic;
    std::getline(file, magic);
    if (!magic.starts_with("ply")) {
        return "it is not a PLY file, whatever its name says";
    }
    const std::optional<PlyHeader> header = readPlyHeader(file);
    if (!header) {
        return "its PLY header is damaged";
    }
    std::uint64_t left = size - static_cast<std::uint64_t>(file.tellg());
    for (const PlyElement& element : header->elements) {
        const std::uint64_t least = std::max<std::uint64_t>(1, element.leastBytes(header->text));
        if (element.count > (left + 1) / least) { // the last line may lack its line break
            return endsBefore(element);
        }
    }
    if (header->text) {
        return {};
    }
    ListWalk walk(file, header->big_endian, left);
    for (const PlyElement& element : header->elements) {
        if (!walk.skip(element)) {
            return endsBefore(element);
        }
    }
    return {};
}

} // namespace quarn
