// An animation of a million frames to a file and back, beside the same bytes copied in memory and
// written or read as they are.
#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_BinaryArchive.h"

#include <benchmark/benchmark.h>

#include <cstdint>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <memory>
#include <span>
#include <string>
#include <vector>

namespace {

constexpr int frame_count = 1'000'000;

using Bytes = std::vector<std::uint8_t>;

// Lives as long as the program; the destructor removes the file.
struct ScratchFile {
    std::filesystem::path path =
        std::filesystem::temp_directory_path() / "bench_record_archive.bin";
    ~ScratchFile() {
        std::error_code ignored;
        std::filesystem::remove(path, ignored);
    }
};

const std::filesystem::path& scratchPath() {
    static const ScratchFile file;
    return file.path;
}

bool writeFile(std::span<const std::uint8_t> bytes) {
    std::ofstream file(scratchPath(), std::ios::binary);
    file.write(reinterpret_cast<const char*>(bytes.data()),
               static_cast<std::streamsize>(bytes.size()));
    return static_cast<bool>(file.flush());
}

// The room is not set to zero first, as neither way of reading needs that.
struct FileContent {
    std::unique_ptr<std::uint8_t[]> bytes;
    std::size_t size = 0;
};

FileContent readFile() {
    FileContent content;
    content.size = std::filesystem::file_size(scratchPath());
    content.bytes = std::make_unique_for_overwrite<std::uint8_t[]>(content.size);
    std::ifstream file(scratchPath(), std::ios::binary);
    file.read(reinterpret_cast<char*>(content.bytes.get()),
              static_cast<std::streamsize>(content.size));
    return content;
}

const KM_3dmAnimationProperties& longTurntable() {
    static const KM_3dmAnimationProperties record = [] {
        KM_3dmAnimationProperties filled;
        filled.SetCaptureType(KM_3dmAnimationProperties::turntable);
        filled.SetFrameCount(frame_count);
        for (int i = 0; i < frame_count; ++i) {
            filled.CameraPoints().Append(KM_3dPoint(i, 0.5 * i, 10));
            filled.TargetPoints().Append(KM_3dPoint(0, 0, 1.0 / (1 + i)));
        }
        return filled;
    }();
    return record;
}

const Bytes& longChunk() {
    static const Bytes chunk = [] {
        KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
        longTurntable().Write(archive);
        return archive.TakeBytes();
    }();
    return chunk;
}

void countBytes(benchmark::State& state) {
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(longChunk().size()));
}

void copyAndWriteFile(benchmark::State& state) {
    const Bytes& source = longChunk();
    for (auto _ : state) {
        const auto copy = std::make_unique_for_overwrite<std::uint8_t[]>(source.size());
        std::memcpy(copy.get(), source.data(), source.size());
        if (!writeFile({copy.get(), source.size()}))
            state.SkipWithError("the file cannot be written");
    }
    countBytes(state);
}

void writeRecord(benchmark::State& state) {
    const KM_3dmAnimationProperties& record = longTurntable();
    for (auto _ : state) {
        KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
        if (!record.Write(archive) || !writeFile(archive.Bytes()))
            state.SkipWithError("the record cannot be written");
    }
    countBytes(state);
}

void readFileAndCopy(benchmark::State& state) {
    if (!writeFile(longChunk()))
        state.SkipWithError("the file cannot be written");
    for (auto _ : state) {
        const FileContent content = readFile();
        const auto copy = std::make_unique_for_overwrite<std::uint8_t[]>(content.size);
        std::memcpy(copy.get(), content.bytes.get(), content.size);
        benchmark::DoNotOptimize(copy.get());
        benchmark::ClobberMemory();
    }
    countBytes(state);
}

void readRecord(benchmark::State& state) {
    if (!writeFile(longChunk()))
        state.SkipWithError("the file cannot be written");
    for (auto _ : state) {
        const FileContent content = readFile();
        KM_BinaryArchive archive =
            KM_BinaryArchive::ForReading({content.bytes.get(), content.size});
        KM_3dmAnimationProperties record;
        if (!record.Read(archive) || record.CameraPoints().Count() != frame_count)
            state.SkipWithError("the record cannot be read");
    }
    countBytes(state);
}

} // namespace

// Times of the clock, as waiting for the file counts.
BENCHMARK(copyAndWriteFile)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(writeRecord)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(readFileAndCopy)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(readRecord)->Unit(benchmark::kMillisecond)->UseRealTime();

BENCHMARK_MAIN();
