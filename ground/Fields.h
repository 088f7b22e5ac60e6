#pragma once

#include "kelmar/KM_BinaryArchive.h"
#include "kelmar/KM_Color.h"

#include <array>
#include <cstdint>
#include <span>
#include <type_traits>
#include <vector>

namespace quarn {

// A layout is one function template, `fields(step, thing)`, that takes the step with one field
// after the other while it succeeds. A FieldWriter as the step writes the thing, a FieldReader
// reads it: one list serves both directions, so that they cannot differ.

/// Writes fields. A step is false, with the archive failed, when the field cannot be written.
class FieldWriter {
public:
    explicit FieldWriter(KM_BinaryArchive& archive) : m_archive(archive) {}

    bool operator()(bool flag) { return m_archive.WriteBool(flag); }
    bool operator()(std::int32_t number) { return m_archive.WriteInt(number); }
    bool operator()(float number) { return m_archive.WriteFloat(number); }
    bool operator()(double number) { return m_archive.WriteDouble(number); }
    bool operator()(const KM_wString& text) { return m_archive.WriteString(text); }
    bool operator()(const KM_UUID& id) { return m_archive.WriteUuid(id); }
    bool operator()(const KM_3dPoint& point) { return m_archive.WritePoint(point); }
    bool operator()(const KM_3dVector& vector) { return m_archive.WriteVector(vector); }
    bool operator()(const KM_Color& color) {
        return m_archive.WriteBytes(std::array{color.r, color.g, color.b, color.a});
    }
    bool operator()(const KM_3dPointArray& points) { return m_archive.WriteArray(points); }
    template <class T> bool operator()(const std::vector<T>& elements) {
        return m_archive.WriteArray(std::span(elements));
    }
    bool operator()(const std::vector<std::uint8_t>& bytes) {
        return m_archive.WriteCount(bytes.size()) && m_archive.WriteBytes(bytes);
    }
    /// An enumeration, as a 4-byte integer.
    template <class E> bool operator()(E value, [[maybe_unused]] E first, [[maybe_unused]] E last) {
        return m_archive.WriteInt(static_cast<std::int32_t>(value));
    }
    /// What has to hold of the fields before.
    bool check(bool makes_sense) { return makes_sense || m_archive.Fail(); }

private:
    KM_BinaryArchive& m_archive;
};

/// Reads fields. A step is false, with the archive failed, when there is no such field.
class FieldReader {
public:
    explicit FieldReader(KM_BinaryArchive& archive) : m_archive(archive) {}

    bool operator()(bool& flag) { return m_archive.ReadBool(flag); }
    bool operator()(std::int32_t& number) { return m_archive.ReadInt(number); }
    bool operator()(float& number) { return m_archive.ReadFloat(number); }
    bool operator()(double& number) { return m_archive.ReadDouble(number); }
    bool operator()(KM_wString& text) { return m_archive.ReadString(text); }
    bool operator()(KM_UUID& id) { return m_archive.ReadUuid(id); }
    bool operator()(KM_3dPoint& point) { return m_archive.ReadPoint(point); }
    bool operator()(KM_3dVector& vector) { return m_archive.ReadVector(vector); }
    bool operator()(KM_Color& color) {
        std::array<std::uint8_t, 4> bytes = {};
        if (!m_archive.ReadBytes(bytes))
            return false;
        color = {bytes[0], bytes[1], bytes[2], bytes[3]};
        return true;
    }
    bool operator()(KM_3dPointArray& points) { return m_archive.ReadArray(points); }
    template <class T> bool operator()(std::vector<T>& elements) {
        return m_archive.ReadArray(elements);
    }
    bool operator()(std::vector<std::uint8_t>& bytes) {
        int count = 0;
        std::span<const std::uint8_t> view;
        if (!m_archive.ReadCount(1, count) ||
            !m_archive.ViewBytes(static_cast<std::uint64_t>(count), view))
            return false;
        bytes.assign(view.begin(), view.end());
        return true;
    }
    /// An enumeration; a number outside `first` to `last` is refused.
    template <class E> bool operator()(E& value, E first, E last) {
        static_assert(std::is_enum_v<E>);
        std::int32_t number = 0;
        if (!m_archive.ReadInt(number))
            return false;
        if (number < static_cast<std::int32_t>(first) || number > static_cast<std::int32_t>(last))
            return m_archive.Fail();
        value = static_cast<E>(number);
        return true;
    }
    /// What has to hold of the fields before.
    bool check(bool makes_sense) { return makes_sense || m_archive.Fail(); }

private:
    KM_BinaryArchive& m_archive;
};

} // namespace quarn
