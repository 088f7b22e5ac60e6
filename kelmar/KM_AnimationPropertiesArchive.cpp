#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_BinaryArchive.h"

#include <algorithm>
#include <cmath>
#include <exception>
#include <utility>

// The record is one chunk. Its payload is the layout version (two 4-byte integers, major and minor)
// and the fields in the order of their declaration. Fields are only ever added at the end, with the
// next minor version; any other change takes the next major version. A payload that ends between
// two fields is therefore one of an older layout, and one that goes on after the last field is one
// of a newer layout, if its version says so.

using Record = KM_3dmAnimationProperties;
using Texts = KM_ClassArray<KM_wString>;

namespace {

constexpr std::uint32_t record_chunk_id = 0x4D494E41; // "ANIM" in the order of bytes
constexpr std::int32_t layout_major = 1;
constexpr std::int32_t layout_minor = 0;

bool isKnown(std::int32_t capture_type) {
    return capture_type >= Record::path && capture_type <= Record::none;
}

// The unset point is finite and counts as a point: it says that a frame has none.
bool areFinite(const KM_3dPointArray& points) {
    return std::all_of(points.begin(), points.end(), [](const KM_3dPoint& point) {
        return std::isfinite(point.x) && std::isfinite(point.y) && std::isfinite(point.z);
    });
}

bool writeField(KM_BinaryArchive& archive, Record::CaptureTypes type) {
    return isKnown(type) ? archive.WriteInt(type) : archive.Fail();
}

bool writeField(KM_BinaryArchive& archive, const KM_3dPointArray& points) {
    return areFinite(points) ? archive.WriteArray(points) : archive.Fail();
}

bool writeField(KM_BinaryArchive& archive, const KM_wString& text) {
    return archive.WriteString(text);
}

bool writeField(KM_BinaryArchive& archive, const KM_UUID& id) {
    return archive.WriteUuid(id);
}

bool writeField(KM_BinaryArchive& archive, std::int32_t number) {
    return archive.WriteInt(number);
}

bool writeField(KM_BinaryArchive& archive, double number) {
    return archive.WriteDouble(number);
}

bool writeField(KM_BinaryArchive& archive, const Texts& texts) {
    return archive.WriteArray(texts);
}

bool writeField(KM_BinaryArchive& archive, bool flag) {
    return archive.WriteBool(flag);
}

bool readField(KM_BinaryArchive& archive, Record::CaptureTypes& type) {
    std::int32_t value = 0;
    if (!archive.ReadInt(value) || !isKnown(value))
        return false;
    type = static_cast<Record::CaptureTypes>(value);
    return true;
}

bool readField(KM_BinaryArchive& archive, KM_3dPointArray& points) {
    return archive.ReadArray(points) && areFinite(points);
}

bool readField(KM_BinaryArchive& archive, KM_wString& text) {
    return archive.ReadString(text);
}

bool readField(KM_BinaryArchive& archive, KM_UUID& id) {
    return archive.ReadUuid(id);
}

bool readField(KM_BinaryArchive& archive, std::int32_t& number) {
    return archive.ReadInt(number);
}

bool readField(KM_BinaryArchive& archive, double& number) {
    return archive.ReadDouble(number);
}

bool readField(KM_BinaryArchive& archive, Texts& texts) {
    return archive.ReadArray(texts);
}

bool readField(KM_BinaryArchive& archive, bool& flag) {
    return archive.ReadBool(flag);
}

} // namespace

// One list of fields serves both directions, so that they cannot differ.
struct KM_3dmAnimationProperties::Fields {
    // Takes the step with one field after the other while it succeeds.
    template <class AnyRecord, class Step> static bool ForEach(AnyRecord& record, Step&& step) {
        return step(record.m_capture_type) && step(record.m_file_extension) &&
               step(record.m_capture_method) && step(record.m_viewport_name) &&
               step(record.m_html_filename) && step(record.m_display_mode) &&
               step(record.m_camera_points) && step(record.m_target_points) &&
               step(record.m_frame_count) && step(record.m_current_frame) &&
               step(record.m_camera_path_id) && step(record.m_target_path_id) &&
               step(record.m_latitude) && step(record.m_longitude) && step(record.m_north_angle) &&
               step(record.m_start_day) && step(record.m_start_month) &&
               step(record.m_start_year) && step(record.m_end_day) && step(record.m_end_month) &&
               step(record.m_end_year) && step(record.m_start_hour) &&
               step(record.m_start_minutes) && step(record.m_start_seconds) &&
               step(record.m_end_hour) && step(record.m_end_minutes) &&
               step(record.m_end_seconds) && step(record.m_days_between_frames) &&
               step(record.m_minutes_between_frames) && step(record.m_light_index) &&
               step(record.m_folder_name) && step(record.m_images) && step(record.m_dates) &&
               step(record.m_render_full) && step(record.m_render_preview);
    }

    static bool Read(KM_BinaryArchive& archive, Record& record) {
        std::int32_t major = 0;
        std::int32_t minor = 0;
        if (!archive.ReadInt(major) || !archive.ReadInt(minor))
            return false;
        if (major != layout_major || minor < 0)
            return false;
        const bool fields_make_sense = ForEach(record, [&](auto& field) {
            return archive.BytesLeft() == 0 || readField(archive, field);
        });
        const bool may_go_on = minor > layout_minor;
        return fields_make_sense && !archive.HasFailed() && (archive.BytesLeft() == 0 || may_go_on);
    }

    static bool ReadChunk(KM_BinaryArchive& archive, Record& record) {
        std::uint32_t id = 0;
        std::uint64_t length = 0;
        return archive.BeginReadChunk(id, length) && id == record_chunk_id &&
               Read(archive, record) && archive.EndReadChunk();
    }

    // About the room that the long fields take: a guess, which costs a copy where it is short.
    static std::uint64_t EstimatedSize(const Record& record) {
        constexpr std::uint64_t short_fields = 1024;
        constexpr std::uint64_t text = 40;
        const auto count = [](const auto& array) {
            return static_cast<std::uint64_t>(array.Count());
        };
        const auto points = count(record.m_camera_points) + count(record.m_target_points);
        const auto texts = count(record.m_images) + count(record.m_dates);
        return short_fields + sizeof(KM_3dPoint) * points + text * texts;
    }
};

bool KM_3dmAnimationProperties::Write(KM_BinaryArchive& archive) const {
    archive.Reserve(Fields::EstimatedSize(*this));
    if (!archive.BeginWriteChunk(record_chunk_id) || !archive.WriteInt(layout_major) ||
        !archive.WriteInt(layout_minor))
        return false;
    const auto write = [&](const auto& field) { return writeField(archive, field); };
    return Fields::ForEach(*this, write) && archive.EndWriteChunk();
}

bool KM_3dmAnimationProperties::Read(KM_BinaryArchive& archive) {
    try {
        KM_3dmAnimationProperties read;
        if (!Fields::ReadChunk(archive, read))
            return archive.Fail();
        *this = std::move(read);
        return true;
    } catch (const std::exception&) { // no memory, even for the defaults
        return archive.Fail();
    }
}
