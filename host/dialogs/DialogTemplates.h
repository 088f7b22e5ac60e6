#pragma once

#include "ground/Result.h"
#include "host/app/StringTables.h"
#include "host/front_end/DialogTemplate.h"

#include <filesystem>
#include <span>
#include <string_view>
#include <vector>

namespace quarn {

/// Where the templates of a dialog are looked for, in this order.
///
/// @param library  the file that the dialog's class is part of
/// @param folders  the session's folders of templates
std::vector<std::filesystem::path>
dialogTemplateFolders(const std::filesystem::path& library,
                      std::span<const std::filesystem::path> folders);

/// Reads the template with this id, in the user's language, from the first of these folders that
/// has it.
/// @return an error when none has it, and as readDialogTemplate
Result<DialogTemplate> findDialogTemplate(int id, std::span<const std::filesystem::path> folders,
                                          const StringTables& texts);

/// Reads a template file, `<id>.dialog.json`, as docs/dialogs.md describes it. Everything in it is
/// checked: what is unknown, missing or twice there is an error that names the file and the place
/// in it.
Result<DialogTemplate> readDialogTemplate(const std::filesystem::path& file,
                                          const StringTables& texts);

/// The same for the text of such a file, whose name is not looked at.
/// @return an error, part of a sentence, that names the place in the text
Result<DialogTemplate> readDialogTemplateText(std::string_view json, const StringTables& texts);

} // namespace quarn
