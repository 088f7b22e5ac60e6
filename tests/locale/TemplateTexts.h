#pragma once

#include "tests/locale/SourceTexts.h"

namespace locale_rules {

/// Every numbered text of a dialog template: `{"text": "English", "id": 12345}`.
std::vector<TextUse> templateTextUses(const std::string& json, const std::filesystem::path& file);

} // namespace locale_rules
