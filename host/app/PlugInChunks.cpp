#include "host/app/PlugInChunks.h"

#include "host/app/Application.h"
#include "host/app/RecordNames.h"
#include "host/border/Border.h"
#include "host/document/file/FileRemainder.h"
#include "sdk/qncore/QnFileOptions.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

#include <algorithm>

namespace quarn {

namespace {

std::string nameOfPlugIn(const CQuarnPlugIn& plug_in) {
    const auto name = acrossBorder([&] { return plug_in.PlugInName(); });
    return name && name.value() ? KM_wString(name.value()).ToUtf8() : std::string("a plug-in");
}

/// Reads the version; the archive keeps it for the plug-in.
bool skipVersion(KM_BinaryArchive& archive) {
    int major = 0;
    int minor = 0;
    return archive.Read3dmChunkVersion(major, minor);
}

/// Takes over what a plug-in wrote. Nothing at all is no chunk.
Result<std::optional<PlugInContent>> contentOf(KM_BinaryArchive& written, const KM_UUID& id) {
    if (written.HasFailed() || written.OpenChunkCount() > 0)
        return Error{"it left what it wrote unfinished"};
    PlugInContent content{id, written.TakeBytes()};
    if (content.bytes.empty())
        return std::optional<PlugInContent>();
    KM_BinaryArchive archive = KM_BinaryArchive::ForReading(content.bytes);
    if (!skipVersion(archive))
        return Error{"it wrote no version"};
    return std::optional(std::move(content));
}

Result<std::optional<PlugInContent>> written(const LoadedPlugIn& loaded, Document& document,
                                             const CQuarnFileWriteOptions& options) {
    CQuarnPlugIn& plug_in = *loaded.plug_in;
    const auto wants = acrossBorder([&] { return plug_in.CallWriteDocument(options); });
    if (!wants)
        return wants.error();
    if (!wants.value())
        return std::optional<PlugInContent>();
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting(options.Quarn3dmVersion());
    const auto wrote =
        acrossBorder([&] { return plug_in.WriteDocument(document.face(), archive, options); });
    if (!wrote)
        return wrote.error();
    if (!wrote.value())
        return Error{"it reports a failure"};
    return contentOf(archive, loaded.id);
}

bool has(const std::vector<PlugInContent>& contents, const KM_UUID& id) {
    return std::ranges::find(contents, id, &PlugInContent::plug_in_id) != contents.end();
}

Result<void> read(CQuarnPlugIn& plug_in, Document& document, const PlugInContent& content,
                  const CQuarnFileReadOptions& options) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForReading(content.bytes);
    skipVersion(archive);
    const auto done =
        acrossBorder([&] { return plug_in.ReadDocument(document.face(), archive, options); });
    if (!done)
        return done.error();
    return done.value() ? Result<void>() : Error{"it is damaged, or of a newer version"};
}

std::string cleanedNamesText() {
    return KM_wString(QnLocalizeString(L"The animation of the file had names or dates with "
                                       L"characters that file names and pages must not hold. \"_\" "
                                       L"stands in their place.",
                                       42553))
        .ToUtf8();
}

/// The plug-in of a chunk; null when it cannot be found.
CQuarnPlugIn* plugInFor(Application& application, const KM_UUID& id) {
    if (!application.plugIns().isLoaded(id))
        (void)application.plugIns().loadById(id, false);
    return application.plugIns().findPlugIn(id);
}

} // namespace

Result<std::vector<PlugInContent>> plugInContents(Application& application, Document& document,
                                                  const CQuarnFileWriteOptions& options) {
    std::vector<PlugInContent> contents;
    for (const LoadedPlugIn& loaded : application.plugIns().loaded()) {
        auto content = written(loaded, document, options);
        if (!content)
            return Error{"what " + nameOfPlugIn(*loaded.plug_in) +
                         " keeps in it cannot be written: " + content.message()};
        if (content.value())
            contents.push_back(std::move(*content.value()));
    }
    if (options.SelectedObjectFilter() || options.Quarn3dmVersion() < KM_CURRENT_ARCHIVE_VERSION)
        return contents;
    for (const PlugInContent& kept : document.fileRemainder().plug_ins)
        if (!has(contents, kept.plug_in_id))
            contents.push_back(kept);
    return contents;
}

PlugInReading readPlugInContents(Application& application, Document& document,
                                 const std::vector<PlugInContent>& contents,
                                 const CQuarnFileReadOptions& options) {
    const bool is_own_file = options.Mode(CQuarnFileReadOptions::open_mode);
    FileRemainder& remainder = document.fileRemainder();
    PlugInReading reading;
    for (const PlugInContent& content : contents) {
        const KM_UUID& id = content.plug_in_id;
        CQuarnPlugIn* plug_in = plugInFor(application, id);
        if (!plug_in) {
            if (is_own_file || !remainder.find(id))
                remainder.keep(content);
            continue;
        }
        const auto done = read(*plug_in, document, content, options);
        remainder.forget(id);
        if (done) {
            reading.read_by.push_back(id);
            continue;
        }
        if (is_own_file)
            remainder.keep(content);
        reading.warnings.push_back("What " + nameOfPlugIn(*plug_in) +
                                   " keeps in the file cannot be read: " + done.message() +
                                   ". The rest of the file is there.");
    }
    if (reading.hasRead(ZoetrixPlugInId) && cleanRecordNames(document))
        reading.warnings.push_back(cleanedNamesText());
    return reading;
}

} // namespace quarn
