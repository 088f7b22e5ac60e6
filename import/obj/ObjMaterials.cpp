#include "import/obj/ObjMaterials.h"

#include "import/text/Words.h"

#include <algorithm>
#include <utility>

namespace quarn {

namespace {

constexpr std::size_t MOST_BYTES = std::size_t{64} << 20;
/// For each one that is missing the folder is searched.
constexpr std::size_t MOST_LIBRARIES = 100;

bool endsWithMtl(std::string_view word) {
    const std::string_view extension =
        word.substr(word.size() - std::min<std::size_t>(word.size(), 4));
    return extension == ".mtl" || extension == ".MTL";
}

/// Names that blanks part, although they may have blanks themselves: each ends with ".mtl".
std::vector<std::string_view> namesOf(std::string_view statement) {
    std::vector<std::string_view> names;
    std::string_view rest = statement;
    const char* begin = statement.data();
    while (!rest.empty()) {
        const std::string_view word = takeWord(rest);
        skipBlanks(rest);
        if (!endsWithMtl(word) && !rest.empty())
            continue;
        names.emplace_back(begin, static_cast<std::size_t>(word.data() + word.size() - begin));
        begin = rest.data();
    }
    return names;
}

} // namespace

ObjMaterials::ObjMaterials(const ModelReading& reading, std::vector<std::string>& warnings)
    : m_reading(reading), m_warnings(warnings), m_textures(reading, warnings) {
    m_made[{}] = {};
}

void ObjMaterials::readLibraries(std::span<const std::string_view> statements) {
    for (const std::string_view statement : statements)
        readStatement(statement);
    if (m_misses_library)
        readNamesake();
}

void ObjMaterials::readStatement(std::string_view statement) {
    if (statement.empty() || m_asked.contains(statement))
        return;
    const std::vector<std::string_view> names = namesOf(statement);
    if (names.size() == 1 || m_reading.folder.find(statement)) {
        readLibrary(statement);
        return;
    }
    for (const std::string_view name : names)
        readLibrary(name);
}

void ObjMaterials::readLibrary(std::string_view name) {
    if (m_asked.size() > MOST_LIBRARIES || !m_asked.emplace(name).second)
        return;
    if (m_asked.size() > MOST_LIBRARIES) {
        m_warnings.push_back("Material files from '" + std::string(name) +
                             "' on were not read: there are more than " +
                             std::to_string(MOST_LIBRARIES) + ".");
        return;
    }
    const std::optional<NamedFile> file = m_reading.folder.find(name);
    if (file && readFile(*file)) {
        if (file->differs_in_case)
            m_warnings.push_back(otherCaseText(name, *file));
        return;
    }
    m_misses_library = true;
    const char* const why = file ? "it cannot be read"
                            : m_reading.folder.leadsOutside(name)
                                ? "it lies outside the model's folder; copy it beside the model"
                                : "there is no such file beside the model";
    m_warnings.push_back("The material file '" + std::string(name) + "' was left out: " + why +
                         ".");
}

/// A model that was renamed with its material file still names it as before.
void ObjMaterials::readNamesake() {
    const std::string name = m_reading.path.stem().string() + ".mtl";
    const std::optional<NamedFile> file = m_reading.folder.find(name);
    if (file && m_asked.insert(name).second && readFile(*file))
        m_warnings.push_back("The material file '" + file->path.filename().string() +
                             "' was read in its place.");
}

bool ObjMaterials::readFile(const NamedFile& file) {
    Result<FileBytes> bytes = readFileBytes(file.path, MOST_BYTES);
    if (!bytes)
        return false;
    Result<FileText> text = FileText::of(bytes.value().bytes(), m_reading.budget);
    if (!text)
        return false;
    m_sources.push_back({std::move(bytes.value()), std::move(text.value())});
    const Source& source = m_sources.back();
    keepMaterials(source.text.text(), file.path.filename().string());
    return true;
}

void ObjMaterials::keepMaterials(std::string_view text, const std::string& file) {
    MaterialFile read = readMaterialFile(text);
    for (FileMaterial& material : read.materials)
        m_found.try_emplace(material.name, std::move(material));
    if (!read.fault.empty())
        m_warnings.push_back("The material file '" + file + "' is damaged: " + read.fault + ".");
}

const ObjMaterial& ObjMaterials::at(std::string_view name) {
    if (const auto made = m_made.find(name); made != m_made.end())
        return made->second;
    const auto found = m_found.find(name);
    if (found == m_found.end())
        m_missing.emplace_back(name);
    return m_made[std::string(name)] = lookOf(
               found != m_found.end() ? found->second : FileMaterial{.name = name}, m_textures);
}

void ObjMaterials::tellMissing() {
    if (m_missing.empty() || m_misses_library)
        return; // which is told already
    constexpr std::size_t MOST_NAMED = 3;
    std::string names;
    for (std::size_t i = 0; i < std::min(MOST_NAMED, m_missing.size()); ++i)
        names += (i > 0 ? ", '" : "'") + m_missing[i] + "'";
    if (m_missing.size() > MOST_NAMED)
        names += " and " + std::to_string(m_missing.size() - MOST_NAMED) + " more";
    m_warnings.push_back("No material file has " + names +
                         (m_missing.size() > 1 ? ": these materials have" : ": this material has") +
                         " the usual look.");
}

} // namespace quarn
