#include "tests/quarn/pages/Workshop.h"

#include "tests/import/environment/RadianceBytes.h"
#include "tests/quarn/Models.h"

#include <cstdint>
#include <gtest/gtest.h>

namespace quarn::test {

namespace {

std::string littleEndian32(std::uint32_t value) {
    std::string bytes;
    for (int shift = 0; shift < 32; shift += 8)
        bytes += static_cast<char>(value >> shift & 0xFF);
    return bytes;
}

/// A triangle of 4 by 4 by 3 metres, as glTF in one file.
std::string glbTriangle() {
    std::string json =
        R"({"asset":{"version":"2.0"},"scene":0,"scenes":[{"nodes":[0]}],)"
        R"("nodes":[{"name":"Roof","mesh":0}],)"
        R"("meshes":[{"primitives":[{"attributes":{"POSITION":0}}]}],)"
        R"("accessors":[{"bufferView":0,"componentType":5126,"count":3,"type":"VEC3",)"
        R"("min":[0,0,0],"max":[4,3,4]}],)"
        R"("bufferViews":[{"buffer":0,"byteLength":36}],"buffers":[{"byteLength":36}]})";
    json.resize((json.size() + 3) / 4 * 4, ' ');
    constexpr std::uint32_t FOUR = 0x40800000; // 4 and 3 as floats
    constexpr std::uint32_t THREE = 0x40400000;
    std::string points;
    for (const std::uint32_t coordinate : {0U, 0U, 0U, FOUR, 0U, 0U, 0U, THREE, FOUR})
        points += littleEndian32(coordinate);
    const auto chunk = [](const std::string& kind, const std::string& bytes) {
        return littleEndian32(static_cast<std::uint32_t>(bytes.size())) + kind + bytes;
    };
    const std::string chunks = chunk("JSON", json) + chunk(std::string("BIN\0", 4), points);
    return "glTF" + littleEndian32(2) +
           littleEndian32(static_cast<std::uint32_t>(12 + chunks.size())) + chunks;
}

constexpr const char* STL_TRIANGLE = "solid part\nfacet normal 0 0 1\nouter loop\nvertex 0 0 0\n"
                                     "vertex 4 0 0\nvertex 0 4 3\nendloop\nendfacet\nendsolid\n";

/// A line through four points, as an object of an OBJ file.
std::string objLine(const std::string& name, double height) {
    std::string text = "o " + name + "\n";
    for (const char* place : {"-9 -9 ", "-3 -8 ", "3 -9 ", "9 -8 "})
        text += "v " + std::string(place) + std::to_string(height) + "\n";
    return text + "l -4 -3 -2 -1\n";
}

} // namespace

Workshop::Workshop() {
    writeModels();
    writeCurves();
    writeDocuments();
    std::filesystem::create_directory(m_folder / "out"); // as a script needs it
    writeFrames();
    writeCluster();
}

Ended Workshop::run(const std::vector<std::string>& arguments, const std::string& input) const {
    Start start;
    start.folder = m_folder.path();
    start.arguments = arguments;
    start.input = input;
    start.environment = {{"XDG_STATE_HOME", (m_folder / "state").native()},
                         {"PATH", (m_folder / "bin").native() + ":/usr/bin:/bin"}};
    return test::run(start);
}

void Workshop::writeModels() const {
    writeHouse(m_folder / "house.obj");
    std::string town = readFile(m_folder / "house.obj");
    town += objLine("Walk", 1.7) + objLine("Fountain", 2.0);
    for (const char* name : {"town.obj", "yard.obj", "pavilion.obj"})
        writeFile(m_folder / name, town);
    for (const char* name : {"house.glb", "model.glb", "hall.glb"})
        writeFile(m_folder / name, glbTriangle());
    for (const char* name : {"part.stl", "machine.stl"})
        writeFile(m_folder / name, STL_TRIANGLE);
    writeFile(m_folder / "sky.hdr", plainRadiance(16, 8, {64, 96, 128, ONE}));
}

void Workshop::writeCurves() const {
    const char* const low = "0 -15 1.6\n0 -9 1.6\n0.5 -4 1.6\n";
    const char* const high = "-8 -8 9\n0 -9 9\n8 -8 9\n";
    for (const char* name : {"walk.txt", "walk2.txt", "frieze.txt"})
        writeFile(m_folder / name, low);
    for (const char* name : {"ring.txt", "arc.txt"})
        writeFile(m_folder / name, high);
    writeFile(m_folder / "frieze.json", R"({"points": [[0, 5, 2], [4, 5, 2]]})");
    writeFile(m_folder / "steps.txt", "_-List\n");
}

void Workshop::writeDocuments() const {
    writeFile(m_folder / "documents.txt",
              "_-ViewportSize 64 48\n_-FitView _Turn=Yes _Enter\n"
              "_-SetTurntableAnimation 200 _Clockwise _jpg _Shaded _Enter _Enter\n"
              "_-SaveAs house.quarn\n_-SaveAs walk.quarn\n_-SaveAs sun.quarn\n"
              "_-SaveAs site.quarn\n"
              "_-ImportCurve [Name] \"Main street\" walk.txt\n"
              "_-ImportCurve [Name] \"Roof line\" arc.txt\n"
              "_-Point _Name Fountain 1,1,1\n_-SaveAs town.quarn\n");
    const Ended ended = run({"run", "documents.txt", "house.obj"});
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
}

void Workshop::writeCluster() const {
    std::filesystem::create_directory(m_folder / "bin");
    const std::string cancelled = (m_folder / "cancelled").native();
    const auto write = [&](const char* name, const std::string& text) {
        writeFile(m_folder / "bin" / name, "#!/bin/sh\n" + text);
        std::filesystem::permissions(m_folder / "bin" / name, std::filesystem::perms::owner_all);
    };
    write("sbatch", "rm -f '" + cancelled + "'\necho 12\n");
    write("squeue", "");
    std::filesystem::create_directory(m_folder / "farmed");
    writeFile(m_folder / "farmed/house.farm.json",
              R"({"name": "house", "document": "house.quarn", "submitted": "", "frames": 2,)"
              R"("frame_seconds": 1, "loading_seconds": 1, "chunks": ["0-1"], "command": [],)"
              R"("arrays": [{"id": "12", "first": 0, "tasks": 1}], "finish": "13"})");
    write("scancel", "touch '" + cancelled + "'\n");
    write("scontrol", "[ \"$2\" = config ] && exit\n[ ! -f '" + cancelled +
                          "' ] && echo JobId=$4 JobState=PENDING Reason=Resources && exit\n"
                          "echo Invalid job id specified >&2\nexit 1\n");
}

void Workshop::writeFrames() const {
    writeFile(m_folder / "frames.txt",
              "_-ViewportSize 64 48\n_-FitView _Turn=Yes _Enter\n_-AnimationName house\n"
              "_-SetTurntableAnimation 2 _Clockwise _jpg _Shaded _Enter _Enter\n"
              "_-SaveAs two.quarn\n");
    for (const std::vector<std::string>& arguments :
         {std::vector<std::string>{"run", "frames.txt", "house.obj"},
          {"record", "two.quarn", "--out", "frames"}}) {
        const Ended ended = run(arguments);
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
    }
}

} // namespace quarn::test
