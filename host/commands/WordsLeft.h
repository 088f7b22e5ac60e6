#pragma once

namespace quarn {

/// Whether the line of the command that runs has words left: answers that were given in advance.
bool hasWordsLeft();

/// Whether the line has words left behind the name of a file that is to be written, which the
/// person is then told. Nothing may be written: a name with blanks stands there without quotes, and
/// another file is meant than its first word names.
bool tellWordsBehindFile();

/// Whether a question may be asked again after an answer that was refused. A person may answer
/// again; where the line was typed, its other words are dropped, as they were written for what
/// comes next. A script may not.
/// @param from_line  whether the refused answer was a word of the command's line
bool mayAskAgain(bool from_line);

} // namespace quarn
