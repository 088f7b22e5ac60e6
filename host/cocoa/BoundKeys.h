#pragma once

#include "ground/Result.h"
#include "sdk/cocoa/QXDialogController.h"

namespace quarn {

/// The keys of a controller that controls of its window show (`bindingKeyNames`). The nib's
/// bindings say which control is whose; they are taken over here, so that a key is written when the
/// dialog is confirmed and not with each edit: a text that its member cannot take stays to be
/// mended, and a dialog that is given up leaves nothing behind.
class BoundKeys {
public:
    /// @param controller  with its window loaded; it must outlive the keys
    /// @return an error when no control of the window is bound to one of the keys
    static Result<BoundKeys> takeOver(QXDialogController* controller);
    ~BoundKeys();
    BoundKeys(BoundKeys&& other) noexcept;
    BoundKeys(const BoundKeys&) = delete;
    BoundKeys& operator=(const BoundKeys&) = delete;

    /// Shows the keys' values in their controls.
    void show() const;
    /// Writes what stands in the controls to the keys.
    void store() const;
    /// Writes the values that the keys had when they were taken over.
    void putBack() const;

private:
    explicit BoundKeys(QXDialogController* controller);

    QXDialogController* m_controller;
    NSMutableDictionary* m_controls; ///< by key
    NSDictionary* m_values;          ///< by key, as they were first
};

} // namespace quarn
