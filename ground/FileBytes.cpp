#include "ground/FileBytes.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <new>
#include <string>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

namespace quarn {

namespace {

Error reason(int code) {
    switch (code) {
    case ENOENT:
    case ENOTDIR:
        return {"there is no such file"};
    case EACCES:
    case EPERM:
        return {"there is no permission to read it"};
    default:
        return {std::strerror(code)};
    }
}

class OpenFile {
public:
    explicit OpenFile(const std::filesystem::path& file)
        // Without waiting: a pipe that nobody writes to would wait for ever.
        : m_descriptor(open(file.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC)) {}
    ~OpenFile() {
        if (isOpen())
            close(m_descriptor);
    }
    OpenFile(const OpenFile&) = delete;
    OpenFile& operator=(const OpenFile&) = delete;

    bool isOpen() const { return m_descriptor >= 0; }
    int descriptor() const { return m_descriptor; }

    /// The length of an ordinary file.
    Result<std::size_t> size() const {
        struct stat status {};
        if (!isOpen() || fstat(m_descriptor, &status) != 0)
            return reason(errno);
        if (!S_ISREG(status.st_mode))
            return Error{S_ISDIR(status.st_mode) ? "it is a folder" : "it is not an ordinary file"};
        return static_cast<std::size_t>(status.st_size);
    }

    /// @return false when there are fewer bytes
    bool readAll(std::uint8_t* bytes, std::size_t size) const {
        while (size > 0) {
            const ssize_t count = read(m_descriptor, bytes, size);
            if (count < 0 && errno == EINTR)
                continue;
            if (count <= 0)
                return false;
            bytes += count;
            size -= static_cast<std::size_t>(count);
        }
        return true;
    }

private:
    int m_descriptor;
};

} // namespace

Result<FileBytes> readFileBytes(const std::filesystem::path& path, std::size_t most_bytes) {
    const OpenFile file(path);
    const Result<std::size_t> length = file.size();
    if (!length)
        return length.error();
    const std::size_t size = length.value();
    if (size > most_bytes)
        return Error{"it has more than " + std::to_string(most_bytes) + " bytes"};
    std::unique_ptr<std::uint8_t[]> bytes(new (std::nothrow) std::uint8_t[size]);
    if (!bytes)
        return Error{"there is too little memory for it"};
    if (!file.readAll(bytes.get(), size))
        return Error{"it could not be read to its end"};
    return FileBytes(std::move(bytes), size);
}

MappedFile::~MappedFile() {
    if (m_size > 0)
        munmap(const_cast<std::uint8_t*>(m_bytes), m_size);
}

Result<MappedFile> mapFile(const std::filesystem::path& path) {
    const OpenFile file(path);
    const Result<std::size_t> size = file.size();
    if (!size)
        return size.error();
    if (size.value() == 0) // which cannot be mapped
        return MappedFile(nullptr, 0);
    void* const bytes = mmap(nullptr, size.value(), PROT_READ, MAP_PRIVATE, file.descriptor(), 0);
    if (bytes == MAP_FAILED)
        return reason(errno);
    return MappedFile(static_cast<const std::uint8_t*>(bytes), size.value());
}

} // namespace quarn
