#pragma once

#include "host/app/Result.h"
#include "host/document/file/DocumentContent.h"

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

/// Hands each plug-in what it keeps in a file. A plug-in that is not loaded is loaded, where it can
/// be found; where it cannot, and where the plug-in cannot read it, the document keeps it.
/// @return what could not be read, in sentences for the person
std::vector<std::string> readPlugInContents(Application& application, Document& document,
                                            const std::vector<PlugInContent>& contents,
                                            const CQuarnFileReadOptions& options);

} // namespace quarn
