#pragma once

#include "ground/Result.h"
#include "import/ImportedModel.h"
#include "import/transfer/SharedBlock.h"

namespace quarn {

// How a model goes from the process that read it to the one that shows it. A block holds the arrays
// of textures, meshes and curves one after the other, then a description that says how long each of
// them is and holds all the rest, then the length of the description. What objects share is there
// once. Both processes belong to one installation: the block is never kept.

/// Appends a model to an empty block. An array's memory is given back as soon as it is written
/// where nobody else holds its mesh or texture, so that the model does not stand in memory twice.
/// @return an error, part of a sentence: there is too little memory
Result<void> writeModel(ImportedModel model, SharedBlock& block);

/// Takes a model out of a block, and trusts nothing in it: every count is compared with what is
/// there before memory is asked for, meshes are valid, numbers finite, choices among those that
/// there are. Materials are made such as can be drawn, and a sentence of the model tells so. The
/// block's memory is given back as the model is taken.
/// @return the model as it was written, sharing what it shared; or an error, part of a sentence:
/// the
///   block holds no whole model, or there is too little memory
Result<ImportedModel> takeModel(SharedBlock& block);

} // namespace quarn
