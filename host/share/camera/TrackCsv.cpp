#include "host/share/camera/CameraFile.h"
#include "host/share/camera/TrackText.h"

#include <charconv>
#include <initializer_list>

namespace quarn {

namespace {

constexpr const char* MORE_COLUMNS =
    "place_y,place_z,target_x,target_y,target_z,direction_x,direction_y,direction_z,"
    "up_x,up_y,up_z,lens_mm,vertical_angle_deg,width,height,"
    "sun_x,sun_y,sun_z,sun_time,sun_zone,sun_azimuth_deg,sun_altitude_deg\r\n";

/// A line of the table.
class Line {
public:
    void add(double number) {
        char text[32];
        const auto end = std::to_chars(std::begin(text), std::end(text), number);
        field() += std::string(text, end.ptr);
    }
    void add(std::initializer_list<double> numbers) {
        for (const double number : numbers)
            add(number);
    }
    template <class Coordinates> void addPoint(const Coordinates& p) { add({p.x, p.y, p.z}); }
    void addText(const std::string& text) {
        if (text.find_first_of(",\"\r\n") == std::string::npos)
            field() += text;
        else
            field() += quoted(text);
    }
    void addNothing(int fields) {
        while (fields-- > 0)
            field();
    }
    std::string text() const { return m_text + "\r\n"; }

private:
    static std::string quoted(const std::string& text) {
        std::string result = "\"";
        for (const char c : text)
            result += c == '"' ? std::string("\"\"") : std::string(1, c);
        return result + '"';
    }
    std::string& field() {
        if (m_has_fields)
            m_text += ',';
        m_has_fields = true;
        return m_text;
    }

    std::string m_text;
    bool m_has_fields = false;
};

void addOpening(const CameraTrack& track, Line& line) {
    const FrameCamera& camera = track.keys.front().camera;
    if (camera.is_parallel) {
        line.addNothing(2);
        line.add({track.opening.width(), track.opening.height()});
    } else {
        line.add({camera.lens_mm, verticalAngle_deg(track.opening)});
        line.addNothing(2);
    }
}

void addMoment(const std::optional<FrameSun>& moment, Line& line) {
    if (!moment)
        return line.addNothing(4);
    line.addText(moment->time);
    line.addText(moment->zone);
    line.add({moment->azimuth_deg, moment->altitude_deg});
}

std::string lineOf(const CameraTrack& track, int frame) {
    const CameraKey& key = track.key(frame);
    Line line;
    line.addText(track.name);
    line.add({static_cast<double>(frame), track.time_s(frame)});
    line.addText(KM_wString(unitName(track.units)).ToUtf8());
    line.addText(key.camera.is_parallel ? "parallel" : "perspective");
    line.addPoint(key.camera.place);
    line.addPoint(key.camera.target);
    line.addPoint(key.direction);
    line.addPoint(key.camera.up);
    addOpening(track, line);
    if (!track.isSunStudy()) {
        line.addNothing(7);
        return line.text();
    }
    const SunKey& sun = track.suns[static_cast<std::size_t>(frame)];
    line.addPoint(sun.to_sun);
    addMoment(sun.moment, line);
    return line.text();
}

} // namespace

std::string trackCsv(const CameraTrack& track) {
    std::string text = CAMERA_TABLE_START;
    text += MORE_COLUMNS;
    for (int frame = 0; frame < track.frameCount(); ++frame)
        text += lineOf(track, frame);
    return text;
}

} // namespace quarn
