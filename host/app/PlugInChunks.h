#pragma once

#include "ground/Result.h"
#include "host/document/file/DocumentContent.h"

#include <algorithm>
#include <string>
#include <vector>

class CQuarnFileReadOptions;
class CQuarnFileWriteOptions;

namespace quarn {

class Application;
class Document;

/// Asks every loaded plug-in for what it keeps in a document, and adds what the document keeps for
/// plug-ins that are not loaded, or that have nothing in place of what they could not read. What
/// is kept for others goes into whole documents of the current version alone: nobody here can tell
/// whether an older program understands it.
/// @return an error, part of a sentence, when a plug-in could not write
Result<std::vector<PlugInContent>> plugInContents(Application& application, Document& document,
                                                  const CQuarnFileWriteOptions& options);

/// How plug-ins took what they keep in a file.
struct PlugInReading {
    std::vector<KM_UUID> read_by; ///< the plug-ins that read theirs
    std::vector<std::string>
        warnings; ///< what could not be taken over, in sentences for the person

    bool hasRead(const KM_UUID& plug_in_id) const {
        return std::ranges::find(read_by, plug_in_id) != read_by.end();
    }
};

/// Hands each plug-in what it keeps in a file. A plug-in that is not loaded is loaded, where it can
/// be found. Of a file that was opened the document keeps what a plug-in cannot read; it keeps what
/// nobody is there to read of every file, but for an imported one not in place of its own. The
/// names of an animation that was read are cleaned (cleanRecordNames), which is a warning.
PlugInReading readPlugInContents(Application& application, Document& document,
                                 const std::vector<PlugInContent>& contents,
                                 const CQuarnFileReadOptions& options);

} // namespace quarn
