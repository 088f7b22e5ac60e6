#pragma once

class QWidget;

namespace quarn::desktop {

/// The window before which a new one is to stand: the dialog that is open already, as only it can
/// be worked on, else the wanted owner, which may be null.
QWidget* topmostOwner(QWidget* wanted);

} // namespace quarn::desktop
