#pragma once

#include "ground/Result.h"
#include "import/ImportedModel.h"
#include "import/ReadingWatch.h"

#include <chrono>
#include <cstdint>
#include <filesystem>

namespace quarn {

/// How a model file is read in a process of its own.
struct ModelReaderOptions {
    UpAxis up = UpAxis::by_format;
    double tolerance = 0.0; ///< as ReadingOptions has it
    /// Bytes of memory that the reader and the model together may take; 0: half of what is
    /// free, and at least 64 MB.
    std::uint64_t most_memory = 0;
    /// Threads that the reader may use; 0: as many as the machine has processors. A reading inside
    /// this process takes what the process may.
    int most_threads = 0;
    /// How long the reading may take; 0: longestReading of the file.
    std::chrono::milliseconds longest{0};
    /// May be null. Asked on the calling thread some fifty times a second while the reader works;
    /// outlives the reading. A reading inside this process asks as readModelFile does.
    ReadingWatch* watch = nullptr;
};

/// How long a file may take to be read: a minute, and half a minute more for every 10 MB.
std::chrono::milliseconds longestReading(std::uint64_t file_bytes);

/// Reads a model file as readModelFile does, but in a process of its own, which harms nobody by
/// what a damaged or hostile file makes of it; docs/model-reader.md says how. The model is checked
/// on arrival. Where the environment says so, reads in this process (ReaderProgram.h).
/// @return the model; or an error, a sentence that names the file: those of readModelFile, and that
///   the reader is missing, cannot be started, stopped unexpectedly, took too long, needed too much
///   memory, that the file changed meanwhile, or that the watch gave it up
Result<ImportedModel> readModel(const std::filesystem::path& path,
                                const ModelReaderOptions& options = {});

} // namespace quarn
