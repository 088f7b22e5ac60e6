#pragma once

namespace quarn {

class Document;

/// Cleans the names of the animation that a plug-in has read from somebody's file. The pages of
/// recordings hold them as they are stored, so in each place nothing may stay that means more than
/// a letter there; it becomes "_":
/// - of the name, the extension and the names of the pictures: what no file's name may hold, and
///   control characters. Without "<" no element begins in the page, and without quotes and
///   backslashes no string of its script ends; "&" and "'" end neither.
/// - of the labels of a sun study's frames: quotes, backslashes, "<", ">" and control characters.
///   They are no file names, and ":" and "/" belong to dates and times.
///
/// The document does not count as changed: its file still says the same to whoever opens it, and
/// nobody wants to be asked to save what was only looked at.
///
/// @return whether something was replaced
bool cleanRecordNames(Document& document);

} // namespace quarn
