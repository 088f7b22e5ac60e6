#include "host/dialogs/DialogTemplates.h"

#include "ground/FileBytes.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <array>
#include <cstdint>
#include <initializer_list>
#include <limits>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

namespace quarn {

namespace {

using Json = nlohmann::json;
using Kind = DialogControl::Kind;

/// More than any form has, and little enough to be read at once.
constexpr std::size_t MOST_BYTES = 1 << 20;
constexpr std::size_t MOST_CONTROLS = 200;

/// OK and Cancel have these ids in every dialog.
constexpr int LAST_RESERVED_ID = 2;

constexpr std::array<std::pair<std::string_view, Kind>, 7> KINDS = {{
    {"text", Kind::text},
    {"number", Kind::number},
    {"integer", Kind::integer},
    {"date", Kind::date},
    {"time", Kind::time},
    {"combo_box", Kind::combo_box},
    {"button", Kind::button},
}};

std::string fileName(int id) {
    return std::to_string(id) + ".dialog.json";
}

/// Why a value is not an object with members of these names only.
std::optional<std::string> unknownMember(const Json& object,
                                         std::initializer_list<std::string_view> known) {
    if (!object.is_object())
        return "is no object";
    for (const auto& [name, value] : object.items())
        if (std::ranges::find(known, name) == known.end())
            return "has \"" + name + "\", which no template knows";
    return std::nullopt;
}

/// A whole number above 0 that an int holds.
std::optional<int> positiveNumber(const Json& object, const char* name) {
    const auto found = object.find(name);
    if (found == object.end() || !found->is_number_integer() || *found < 1 ||
        *found > std::numeric_limits<int>::max())
        return std::nullopt;
    return found->get<int>();
}

/// Reads the parts of one template.
class TemplateReader {
public:
    explicit TemplateReader(const StringTables& texts) : m_texts(texts) {}

    Result<DialogTemplate> read(const Json& root) const {
        if (const auto fault = unknownMember(root, {"id", "title", "controls"}))
            return Error{"the file " + *fault};
        DialogTemplate form;
        const auto id = positiveNumber(root, "id");
        if (!id)
            return Error{"\"id\" is no whole number above 0"};
        form.id = *id;
        Result<KM_wString> title = readText(root, "title");
        if (!title)
            return title.error();
        form.title = std::move(title.value());
        const Result<void> controls = readControls(root, form);
        return controls ? Result<DialogTemplate>(std::move(form)) : controls.error();
    }

private:
    Result<void> readControls(const Json& root, DialogTemplate& form) const {
        const auto list = root.find("controls");
        if (list == root.end() || !list->is_array())
            return Error{"\"controls\" is no list"};
        if (list->size() > MOST_CONTROLS)
            return Error{"it has more than " + std::to_string(MOST_CONTROLS) + " controls"};
        for (const Json& entry : *list) {
            Result<DialogControl> control = readControl(entry);
            const std::string place = "control " + std::to_string(form.controls.size() + 1);
            if (!control)
                return Error{place + ": " + control.message()};
            const int id = control.value().id;
            if (std::ranges::find(form.controls, id, &DialogControl::id) != form.controls.end())
                return Error{place + " has the id " + std::to_string(id) + ", as one before it"};
            if (control.value().joins_row && form.controls.empty())
                return Error{place + " has no row to join: it is the first one"};
            form.controls.push_back(std::move(control.value()));
        }
        return {};
    }

    Result<DialogControl> readControl(const Json& entry) const {
        if (const auto fault = unknownMember(entry, {"id", "kind", "label", "hint", "joins_row"}))
            return Error{"it " + *fault};
        DialogControl control;
        const auto id = positiveNumber(entry, "id");
        if (!id || *id <= LAST_RESERVED_ID)
            return Error{"\"id\" is no whole number above 2 (OK and Cancel are 1 and 2)"};
        control.id = *id;
        const std::optional<Kind> kind = readKind(entry);
        if (!kind)
            return Error{"\"kind\" is none of " + kindNames()};
        control.kind = *kind;
        if (const Result<void> texts = readTexts(entry, control); !texts)
            return texts.error();
        if (const auto joins = entry.find("joins_row"); joins != entry.end()) {
            if (!joins->is_boolean())
                return Error{"\"joins_row\" is neither true nor false"};
            control.joins_row = joins->get<bool>();
        }
        return control;
    }

    Result<void> readTexts(const Json& entry, DialogControl& control) const {
        Result<KM_wString> label = readText(entry, "label");
        if (!label)
            return label.error();
        control.label = std::move(label.value());
        if (!entry.contains("hint"))
            return {};
        Result<KM_wString> hint = readText(entry, "hint");
        if (!hint)
            return hint.error();
        control.hint = std::move(hint.value());
        return {};
    }

    static std::optional<Kind> readKind(const Json& entry) {
        const auto found = entry.find("kind");
        if (found == entry.end() || !found->is_string())
            return std::nullopt;
        const std::string& name = found->get_ref<const std::string&>();
        const auto kind = std::ranges::find(KINDS, name, [](const auto& row) { return row.first; });
        return kind == KINDS.end() ? std::nullopt : std::optional(kind->second);
    }

    static std::string kindNames() {
        std::string names;
        for (const auto& [name, kind] : KINDS)
            names += (names.empty() ? "\"" : ", \"") + std::string(name) + "\"";
        return names;
    }

    /// Reads `"name": {"text": "English", "id": 123}` in the user's language; without an id the
    /// English text stands in every language.
    Result<KM_wString> readText(const Json& object, const char* name) const {
        const std::string quoted = "\"" + std::string(name) + "\"";
        const auto found = object.find(name);
        if (found == object.end())
            return Error{quoted + " is missing"};
        if (const auto fault = unknownMember(*found, {"text", "id"}))
            return Error{quoted + " " + *fault};
        const auto english = found->find("text");
        if (english == found->end() || !english->is_string() ||
            english->get_ref<const std::string&>().empty())
            return Error{quoted + " has no \"text\" in English"};
        const auto id = positiveNumber(*found, "id");
        if (!id && found->contains("id"))
            return Error{"the \"id\" of " + quoted + " is no whole number above 0"};
        const wchar_t* local = id ? m_texts.find(TextSpace::strings, *id) : nullptr;
        return local ? KM_wString(local)
                     : KM_wString::FromUtf8(english->get_ref<const std::string&>());
    }

    const StringTables& m_texts;
};

Result<Json> parse(std::string_view text) {
    try {
        return Json::parse(text);
    } catch (const Json::parse_error& fault) {
        const std::string_view before = text.substr(0, fault.byte);
        return Error{"it is no JSON from line " +
                     std::to_string(1 + std::ranges::count(before, '\n')) + " on"};
    } catch (const Json::exception&) {
        return Error{"it has a number that is too large"};
    }
}

Result<DialogTemplate> readChecked(const std::filesystem::path& file, const StringTables& texts) {
    const Result<FileBytes> read = readFileBytes(file, MOST_BYTES);
    if (!read)
        return read.error();
    const std::span<const std::uint8_t> bytes = read.value().bytes();
    Result<DialogTemplate> form =
        readDialogTemplateText({reinterpret_cast<const char*>(bytes.data()), bytes.size()}, texts);
    if (form && fileName(form.value().id) != file.filename().string())
        return Error{"its \"id\" is " + std::to_string(form.value().id) +
                     ", which is not that of the file's name"};
    return form;
}

} // namespace

std::vector<std::filesystem::path>
dialogTemplateFolders(const std::filesystem::path& library,
                      std::span<const std::filesystem::path> folders) {
    const std::filesystem::path name = library.stem();
    std::vector<std::filesystem::path> places = {library.parent_path() / "dialogs" / name};
    for (const std::filesystem::path& folder : folders)
        places.push_back(folder / name);
    places.insert(places.end(), folders.begin(), folders.end());
    return places;
}

Result<DialogTemplate> findDialogTemplate(int id, std::span<const std::filesystem::path> folders,
                                          const StringTables& texts) {
    std::string searched;
    for (const std::filesystem::path& folder : folders) {
        std::error_code error;
        const std::filesystem::path file = folder / fileName(id);
        if (std::filesystem::exists(file, error))
            return readDialogTemplate(file, texts);
        searched += (searched.empty() ? "" : ", ") + folder.string();
    }
    return Error{"There is no dialog template " + fileName(id) + " in " + searched +
                 ". Install the plug-in with all its files."};
}

Result<DialogTemplate> readDialogTemplateText(std::string_view json, const StringTables& texts) {
    const Result<Json> root = parse(json);
    return root ? TemplateReader(texts).read(root.value()) : root.error();
}

Result<DialogTemplate> readDialogTemplate(const std::filesystem::path& file,
                                          const StringTables& texts) {
    Result<DialogTemplate> form = readChecked(file, texts);
    if (!form)
        return Error{"The dialog template " + file.string() + " cannot be used: " + form.message() +
                     ". Mend it or install the plug-in again."};
    return form;
}

} // namespace quarn
