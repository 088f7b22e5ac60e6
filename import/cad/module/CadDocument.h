#pragma once

#include "ground/Result.h"
#include "import/cad/CadModule.h"

#include <TDocStd_Document.hxx>

namespace quarn {

/// Reads a file into the library's document of parts, colours and names; lengths of STEP and IGES
/// in millimetres.
/// @return an error whose message is why not, a part of a sentence
Result<Handle(TDocStd_Document)> readCadDocument(const ModelReading& reading, CadFormat format);

/// The sentence that says so where the file's end is missing, else empty.
std::string cutOffText(const ModelReading& reading, CadFormat format);

} // namespace quarn
