#include "host/share/camera/GltfFile.h"

#include "host/share/Base64Text.h"
#include "host/share/camera/CameraFile.h"
#include "host/share/camera/GltfKeys.h"
#include "host/share/camera/GltfPose.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <cfloat>
#include <cmath>
#include <cstdint>

namespace quarn {

namespace {

using Json = nlohmann::ordered_json;

/// Of direct sunlight about noon on a clear day; the format counts in lux.
constexpr double SUNLIGHT_LUX = 100000.0;
constexpr const char* LIGHTS = "KHR_lights_punctual";
/// A place that is this much of the camera's distance from its target off cannot be seen.
constexpr double UNSEEN = 1e-5;

/// What moves, as floats one after the other.
struct MovingNode {
    std::vector<float> places; ///< three a frame; empty: it stays where it is
    std::vector<float> turns;  ///< four a frame

    template <class Numbers> static void append(const Numbers& numbers, std::vector<float>& to) {
        for (const double number : numbers)
            to.push_back(static_cast<float>(number));
    }
};

bool fits(double number) {
    return std::abs(number) <= FLT_MAX;
}

Error tooFarAway(int frame) {
    return {KM_wString::FormatToString(
                QnLocalizeString(L"The camera of frame %d stands too far away for glTF. Give a "
                                 L"file that ends in .json or .csv.",
                                 42830),
                frame)
                .ToUtf8()};
}

bool areUsable(const GltfLens& lens) {
    const double sizes[] = {lens.half_width, lens.half_height, lens.far_distance, lens.setback};
    return std::all_of(std::begin(sizes), std::end(sizes), fits);
}

Result<MovingNode> cameraNode(const CameraTrack& track, const GltfLens& lens) {
    MovingNode node;
    GltfTurn before{};
    for (std::size_t frame = 0; frame < track.keys.size(); ++frame) {
        GltfPose pose = cameraPose(track, lens, track.keys[frame]);
        if (!std::all_of(pose.place.begin(), pose.place.end(), fits))
            return tooFarAway(static_cast<int>(frame));
        before = pose.turn = continued(pose.turn, before);
        MovingNode::append(pose.place, node.places);
        MovingNode::append(pose.turn, node.turns);
    }
    if (!areUsable(lens))
        return tooFarAway(0);
    return node;
}

MovingNode sunNode(const CameraTrack& track) {
    MovingNode node;
    for (const GltfTurn& turn : lightTurns(track.suns))
        MovingNode::append(turn, node.turns);
    return node;
}

Json cameraJson(const GltfLens& lens) {
    Json planes = {{"znear", lens.near_distance}, {"zfar", lens.far_distance}};
    if (lens.is_parallel) {
        planes["xmag"] = lens.half_width;
        planes["ymag"] = lens.half_height;
        return {{"type", "orthographic"}, {"orthographic", planes}};
    }
    planes["yfov"] = lens.vertical_angle;
    planes["aspectRatio"] = lens.aspect;
    return {{"type", "perspective"}, {"perspective", planes}};
}

template <std::size_t Count> Json firstOf(const std::vector<float>& numbers) {
    return std::vector<float>(numbers.begin(), numbers.begin() + Count);
}

Json channel(int sampler, int node, const char* path) {
    return {{"sampler", sampler}, {"target", {{"node", node}, {"path", path}}}};
}

/// Lets a node move, and stands it where it begins.
void animate(const MovingNode& moving, int node, int times, GltfKeys& keys, Json& gltf) {
    Json& animation = gltf["animations"][0];
    const auto add = [&](const std::vector<float>& numbers, int components, const char* path) {
        const int sampler = static_cast<int>(animation["samplers"].size());
        animation["samplers"].push_back({{"input", times},
                                         {"output", keys.add(numbers, components)},
                                         {"interpolation", "LINEAR"}});
        animation["channels"].push_back(channel(sampler, node, path));
    };
    if (!moving.places.empty())
        add(moving.places, 3, "translation");
    add(moving.turns, 4, "rotation");
}

void addSun(const CameraTrack& track, int times, GltfKeys& keys, Json& gltf) {
    const MovingNode sun = sunNode(track);
    gltf["extensionsUsed"] = Json::array({LIGHTS});
    gltf["extensions"][LIGHTS]["lights"] = Json::array({{{"type", "directional"},
                                                         {"name", "Sun"},
                                                         {"color", {1.0, 1.0, 1.0}},
                                                         {"intensity", SUNLIGHT_LUX}}});
    Json node = {{"name", "Sun"}, {"rotation", firstOf<4>(sun.turns)}};
    node["extensions"][LIGHTS]["light"] = 0;
    gltf["nodes"].push_back(std::move(node));
    gltf["scenes"][0]["nodes"].push_back(1);
    animate(sun, 1, times, keys, gltf);
}

std::vector<float> timesOf(const CameraTrack& track) {
    std::vector<float> times;
    for (int frame = 0; frame < track.frameCount(); ++frame)
        times.push_back(static_cast<float>(track.time_s(frame)));
    return times;
}

Json sceneJson(const CameraTrack& track, const GltfLens& lens, const MovingNode& camera,
               GltfKeys& keys) {
    Json gltf = {{"asset",
                  {{"version", "2.0"},
                   {"generator", "quarn " QUARN_VERSION},
                   {"extras", {{"format", CAMERA_FILE_MARK}}}}},
                 {"scene", 0}};
    gltf["scenes"] = Json::array({{{"name", track.name}, {"nodes", {0}}}});
    gltf["nodes"] = Json::array({{{"name", track.name},
                                  {"camera", 0},
                                  {"translation", firstOf<3>(camera.places)},
                                  {"rotation", firstOf<4>(camera.turns)}}});
    gltf["cameras"] = Json::array({cameraJson(lens)});
    gltf["animations"] = Json::array(
        {{{"name", track.name}, {"channels", Json::array()}, {"samplers", Json::array()}}});
    const int times = keys.add(timesOf(track), 1);
    if (track.isSunStudy())
        addSun(track, times, keys, gltf);
    else
        animate(camera, 0, times, keys, gltf);
    gltf["accessors"] = keys.accessors();
    gltf["bufferViews"] = keys.bufferViews();
    gltf["buffers"] = Json::array({{{"byteLength", keys.bytes().size()}}});
    return gltf;
}

void appendNumber(std::size_t number, std::string& bytes) {
    for (int shift = 0; shift < 32; shift += 8)
        bytes += static_cast<char>(number >> shift & 0xFF);
}

/// @param type  four bytes; a shorter word ends in a zero
void appendChunk(const char* type, std::string chunk, char padding, std::string& bytes) {
    chunk.resize((chunk.size() + 3) / 4 * 4, padding);
    appendNumber(chunk.size(), bytes);
    bytes.append(type, 4);
    bytes += chunk;
}

std::string binaryFile(const Json& gltf, std::span<const std::byte> keys) {
    std::string chunks;
    appendChunk("JSON", gltf.dump(), ' ', chunks);
    appendChunk("BIN", {reinterpret_cast<const char*>(keys.data()), keys.size()}, '\0', chunks);
    std::string bytes = "glTF";
    appendNumber(2, bytes);
    appendNumber(12 + chunks.size(), bytes);
    return bytes + chunks;
}

std::string textFile(Json gltf, std::span<const std::byte> keys) {
    gltf["buffers"][0]["uri"] = "data:application/octet-stream;base64," + base64Text(keys);
    return gltf.dump(2) + "\n";
}

/// Half the step between floats, at the farthest place in the direction that counts most.
double lostBy(const CameraTrack& track, const std::vector<float>& places) {
    float farthest = 0.0F;
    for (const float coordinate : places)
        farthest = std::max(farthest, std::abs(coordinate));
    double nearest_target = HUGE_VAL;
    for (const CameraKey& key : track.keys)
        nearest_target = std::min(nearest_target, key.camera.place.DistanceTo(key.camera.target));
    const double metres = track.units == UnitSystem::none ? 1.0 : metresPerUnit(track.units);
    const double lost_m = 0.5 * (std::nextafter(farthest, FLT_MAX) - farthest);
    return lost_m > UNSEEN * metres * nearest_target ? lost_m : 0.0;
}

} // namespace

Result<GltfFile> gltfFile(const CameraTrack& track, GltfForm form) {
    const GltfLens lens = gltfLens(track);
    const auto camera = cameraNode(track, lens);
    if (!camera)
        return camera.error();
    GltfKeys keys;
    const Json gltf = sceneJson(track, lens, camera.value(), keys);
    GltfFile file;
    file.bytes =
        form == GltfForm::binary ? binaryFile(gltf, keys.bytes()) : textFile(gltf, keys.bytes());
    file.is_straightened = lens.is_straightened;
    file.lost_m = lostBy(track, camera.value().places);
    return file;
}

} // namespace quarn
