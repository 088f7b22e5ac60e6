#pragma once

#include <filesystem>
#include <vector>

namespace quarn::test {

/// The model files below these folders that are no larger than `most_bytes`, in an order that is
/// the same on every machine: those whose extension a reader knows.
std::vector<std::filesystem::path> smallModels(const std::vector<std::filesystem::path>& folders,
                                               std::uintmax_t most_bytes);

/// Copies what stands beside a model, for the files that it names: small files of its folder and of
/// the folders in it.
/// @param to  an empty folder
void copyCompanions(const std::filesystem::path& model, const std::filesystem::path& to);

} // namespace quarn::test
