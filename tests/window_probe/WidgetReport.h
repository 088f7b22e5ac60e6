#pragma once

#include <QJsonObject>

namespace quarn::test {

/// Everything that a person sees of the program's windows now: each visible widget with its place
/// on the screen, what it says, and the parts of it that can be clicked; and all named actions.
QJsonObject reportWindows();

} // namespace quarn::test
