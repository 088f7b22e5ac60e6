#pragma once

#include "kelmar/KM_Point.h"
#include "sdk/qncore/QnExport.h"

namespace quarn {
class DocumentSun;
}

/// The sun that shines on a document in the modes that use its lights. Changes are made between
/// BeginChange and EndChange, so that views are told once.
///
/// All calls belong on the main thread and to an open document. Any other is a breach of the
/// interface: it is reported, changes nothing and returns false or the direction straight up.
class QNCORE_API CQuarnSun {
public:
    /// What a change is made by.
    enum change_kind : int {
        change_by_user = 1,   ///< a person's edit
        change_by_program = 2 ///< a program's, to be undone by the program itself
    };

    bool IsEnabled() const;

    /// Opens a change; changes nest.
    void BeginChange(int kind);
    /// Turns the sun on or off. Without an open change nothing happens.
    void SetEnabled(bool enabled);
    /// Closes the change. @return true when anything changed in it
    bool EndChange();

    /// The unit vector from the model toward the sun (x east, y north, z up).
    KM_3dVector DirectionToSun() const;

private:
    friend class quarn::DocumentSun;
    explicit CQuarnSun(quarn::DocumentSun& sun) : m_sun(&sun) {}
    quarn::DocumentSun* m_sun;
};
