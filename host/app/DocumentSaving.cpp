#include "host/app/DocumentSaving.h"

#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/app/FileOptionsAccess.h"
#include "host/app/PlugInChunks.h"
#include "host/document/Document.h"
#include "host/document/file/DocumentFile.h"
#include "host/document/file/FileRemainder.h"
#include "host/document/file/SurfaceLayout.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

#include <map>

namespace quarn {

namespace {

/// The record names the sun light of an animation by its place in the light table of the file; here
/// it stands elsewhere, or is gone.
void moveLightIndex(Document& document, const std::map<int, int>& indices) {
    KM_3dmAnimationProperties record = document.properties().AnimationProperties();
    const auto moved = indices.find(record.LightIndex());
    record.SetLightIndex(moved == indices.end() ? LightStore::no_index : moved->second);
    document.properties().SetAnimationProperties(record);
}

void warnOfLostSurfaces(const DocumentContent& content, std::vector<std::string>& warnings) {
    if (content.lost_surfaces)
        warnings.push_back(
            KM_wString(QnLocalizeString(L"An older program saved the document. What it does not "
                                        L"know of materials is lost: metal, roughness, light, "
                                        L"glass, and the textures of these. A copy made earlier "
                                        L"may hold it.",
                                        42900))
                .ToUtf8());
}

void tellLostSurfaces(int version) {
    Application::current()->tell(
        KM_wString::FormatToString(
            QnLocalizeString(L"A file of version %d holds no more of materials than their base "
                             L"colour: metal, roughness, light, glass and the textures of these "
                             L"were left out.",
                             42901),
            version)
            .ToUtf8());
}

} // namespace

Result<DocumentContent> contentToSave(Document& document, const DocumentSaveOptions& options) {
    DocumentContent content = document.content(options.only_selected);
    content.version = options.version;
    if (const auto added = addPlugInContent(document, content, options); !added)
        return added.error();
    return content;
}

Result<void> addPlugInContent(Document& document, DocumentContent& content,
                              const DocumentSaveOptions& options) {
    auto plug_ins =
        plugInContents(*Application::current(), document,
                       FileOptionsAccess::forWriting(options.only_selected, options.version,
                                                     document.serialNumber()));
    if (!plug_ins)
        return plug_ins.error();
    content.plug_ins = std::move(plug_ins.value());
    if (!options.only_selected && options.version == KM_CURRENT_ARCHIVE_VERSION)
        content.unknown = document.fileRemainder().unknown;
    return {};
}

Result<void> saveDocument(Document& document, const std::filesystem::path& file,
                          const DocumentSaveOptions& options) {
    const auto content = contentToSave(document, options);
    if (!content)
        return Error{"Cannot save " + textFromPath(file).ToUtf8() + ": " + content.message() + "."};
    const auto written = writeDocumentFile(content.value(), file, options.protection);
    if (!written)
        return written.error();
    if (!written.value().warning.empty())
        Application::current()->tell(written.value().warning);
    if (losesSurfaces(content.value()))
        tellLostSurfaces(options.version);
    return {};
}

std::vector<std::string> openContent(Document& document, const DocumentContent& content) {
    std::vector<std::string> warnings = document.openContent(content);
    const auto options = FileOptionsAccess::forReading(CQuarnFileReadOptions::open_mode);
    const PlugInReading reading =
        readPlugInContents(*Application::current(), document, content.plug_ins, options);
    warnings.insert(warnings.end(), reading.warnings.begin(), reading.warnings.end());
    warnOfLostSurfaces(content, warnings);
    return warnings;
}

std::vector<std::string> importContent(Document& document, const DocumentContent& content) {
    const std::map<int, int> light_indices = document.addContent(content);
    const auto options = FileOptionsAccess::forReading(CQuarnFileReadOptions::import_mode);
    PlugInReading reading =
        readPlugInContents(*Application::current(), document, content.plug_ins, options);
    if (reading.hasRead(ZoetrixPlugInId))
        moveLightIndex(document, light_indices);
    warnOfLostSurfaces(content, reading.warnings);
    return std::move(reading.warnings);
}

} // namespace quarn
