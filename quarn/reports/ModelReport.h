#pragma once

#include "quarn/session/HostSession.h"

namespace quarn::program {

enum class ReportForm { text, json };

/// `quarn info`: reads a model file or a document and tells what is in it, to people or to
/// programs.
Outcome reportModel(const std::filesystem::path& model, ReportForm form,
                    const CommonOptions& common);

} // namespace quarn::program
