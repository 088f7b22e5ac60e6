#include "kelmar/KM_BinaryArchive.h"
#include "kelmar/KM_LittleEndian.h"

#include <algorithm>
#include <bit>
#include <cstring>
#include <exception>
#include <limits>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>

namespace {

constexpr std::uint64_t count_size = sizeof(std::uint64_t);
constexpr std::uint64_t max_count = std::numeric_limits<int>::max();

// Elements lie in memory as they lie in the archive: numbers without gaps, lowest byte first.
template <class T>
constexpr bool is_plain = std::is_trivially_copyable_v<T>&& std::is_standard_layout_v<T>;

static_assert(std::endian::native == std::endian::little);
static_assert(sizeof(KM_3dPoint) == 24 && sizeof(KM_3fPoint) == 12 && sizeof(KM_3fVector) == 12);
static_assert(sizeof(KM_2fPoint) == 8 && sizeof(KM_Color) == 4 && sizeof(KM_MeshTriangle) == 12);

} // namespace

template <class T> bool KM_BinaryArchive::WriteRun(std::span<const T> elements) {
    static_assert(is_plain<T>);
    return WriteBytes(
        {reinterpret_cast<const std::uint8_t*>(elements.data()), elements.size_bytes()});
}

template <class T> bool KM_BinaryArchive::ReadRun(std::span<T> elements) {
    static_assert(is_plain<T>);
    std::span<const std::uint8_t> source;
    if (!ViewBytes(elements.size_bytes(), source))
        return false;
    if (!source.empty())
        std::memcpy(elements.data(), source.data(), source.size());
    return true;
}

template <class T> bool KM_BinaryArchive::WriteElements(std::span<const T> elements) {
    return WriteCount(elements.size()) && WriteRun(elements);
}

template <class T> bool KM_BinaryArchive::ReadElements(std::vector<T>& elements) {
    int count = 0;
    if (!ReadCount(sizeof(T), count))
        return false;
    try {
        std::vector<T> read(static_cast<std::size_t>(count));
        if (!ReadRun(std::span(read)))
            return false;
        elements = std::move(read);
        return true;
    } catch (const std::exception&) {
        return Fail();
    }
}

bool KM_BinaryArchive::WriteCount(std::uint64_t count) {
    if (count > max_count)
        return Fail();
    return WriteBytes(kelmar::toLittleEndian(count));
}

bool KM_BinaryArchive::ReadCount(std::uint64_t smallest_element, int& count) {
    std::span<const std::uint8_t> bytes;
    if (!ViewBytes(count_size, bytes))
        return false;
    const auto read = kelmar::fromLittleEndian<std::uint64_t>(bytes.data());
    const std::uint64_t that_fit = BytesLeft() / std::max<std::uint64_t>(smallest_element, 1);
    if (read > max_count || read > that_fit)
        return Fail();
    count = static_cast<int>(read);
    return true;
}

bool KM_BinaryArchive::WriteString(const KM_wString& text) {
    try {
        const std::string utf8 = text.ToUtf8();
        const auto* const bytes = reinterpret_cast<const std::uint8_t*>(utf8.data());
        return WriteCount(utf8.size()) && WriteBytes({bytes, utf8.size()});
    } catch (const std::exception&) {
        return Fail();
    }
}

bool KM_BinaryArchive::ReadString(KM_wString& text) {
    int size = 0;
    std::span<const std::uint8_t> bytes;
    if (!ReadCount(1, size) || !ViewBytes(static_cast<std::uint64_t>(size), bytes))
        return false;
    try {
        const std::string_view utf8(reinterpret_cast<const char*>(bytes.data()), bytes.size());
        KM_wString read = KM_wString::FromUtf8(utf8);
        // Ill-formed parts became replacement characters, which do not go back to what they were.
        if (read.ToUtf8() != utf8)
            return Fail();
        text = std::move(read);
        return true;
    } catch (const std::exception&) {
        return Fail();
    }
}

bool KM_BinaryArchive::WriteArray(const KM_3dPointArray& points) {
    return WriteElements(std::span(points.begin(), points.end()));
}

bool KM_BinaryArchive::ReadArray(KM_3dPointArray& points) {
    int count = 0;
    if (!ReadCount(sizeof(KM_3dPoint), count))
        return false;
    try {
        KM_3dPointArray read;
        read.SetCount(count);
        if (!ReadRun(std::span(read.begin(), read.end())))
            return false;
        points = std::move(read);
        return true;
    } catch (const std::exception&) {
        return Fail();
    }
}

bool KM_BinaryArchive::WriteArray(const KM_ClassArray<KM_wString>& texts) {
    if (!WriteCount(static_cast<std::uint64_t>(texts.Count())))
        return false;
    for (const KM_wString& text : texts) {
        if (!WriteString(text))
            return false;
    }
    return true;
}

bool KM_BinaryArchive::ReadArray(KM_ClassArray<KM_wString>& texts) {
    int count = 0;
    if (!ReadCount(count_size, count))
        return false;
    try {
        KM_ClassArray<KM_wString> read;
        read.SetCount(count);
        for (KM_wString& text : read) {
            if (!ReadString(text))
                return false;
        }
        texts = std::move(read);
        return true;
    } catch (const std::exception&) {
        return Fail();
    }
}

bool KM_BinaryArchive::WriteArray(std::span<const std::int32_t> numbers) {
    return WriteElements(numbers);
}

bool KM_BinaryArchive::ReadArray(std::vector<std::int32_t>& numbers) {
    return ReadElements(numbers);
}

bool KM_BinaryArchive::WriteArray(std::span<const double> numbers) {
    return WriteElements(numbers);
}

bool KM_BinaryArchive::ReadArray(std::vector<double>& numbers) {
    return ReadElements(numbers);
}

bool KM_BinaryArchive::WriteArray(std::span<const KM_3fPoint> points) {
    return WriteElements(points);
}

bool KM_BinaryArchive::ReadArray(std::vector<KM_3fPoint>& points) {
    return ReadElements(points);
}

bool KM_BinaryArchive::WriteArray(std::span<const KM_3fVector> vectors) {
    return WriteElements(vectors);
}

bool KM_BinaryArchive::ReadArray(std::vector<KM_3fVector>& vectors) {
    return ReadElements(vectors);
}

bool KM_BinaryArchive::WriteArray(std::span<const KM_2fPoint> points) {
    return WriteElements(points);
}

bool KM_BinaryArchive::ReadArray(std::vector<KM_2fPoint>& points) {
    return ReadElements(points);
}

bool KM_BinaryArchive::WriteArray(std::span<const KM_Color> colors) {
    return WriteElements(colors);
}

bool KM_BinaryArchive::ReadArray(std::vector<KM_Color>& colors) {
    return ReadElements(colors);
}

bool KM_BinaryArchive::WriteArray(std::span<const KM_MeshTriangle> triangles) {
    return WriteElements(triangles);
}

bool KM_BinaryArchive::ReadArray(std::vector<KM_MeshTriangle>& triangles) {
    return ReadElements(triangles);
}
