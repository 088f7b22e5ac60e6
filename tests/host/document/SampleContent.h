#pragma once

#include "host/document/file/DocumentContent.h"

namespace quarn::test {

/// A document's content with at least one of everything that a file can hold.
DocumentContent sampleContent();

/// The ids that things of the sample have.
KM_UUID sampleId(std::uint32_t number);

} // namespace quarn::test
