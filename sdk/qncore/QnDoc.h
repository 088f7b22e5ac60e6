#pragma once

#include "kelmar/KM_Array.h"
#include "sdk/qncore/QnDocProperties.h"
#include "sdk/qncore/QnExport.h"
#include "sdk/qncore/QnLightTable.h"
#include "sdk/qncore/QnObject.h"
#include "sdk/qncore/QnSun.h"

class CQuarnView;
namespace quarn {
class Document;
}

/// An open document. Owned by the host; stays open while a command runs. All calls belong on the
/// main thread.
///
/// A plug-in that keeps a pointer longer keeps an object that stays until the session ends, but
/// once the document was closed every call on it, on its properties, its lights and its sun is a
/// breach of the interface: it is reported, as in "CQuarnDoc::Regen: the document was closed",
/// changes nothing and returns its number, an empty list, the tolerance of a new document, the
/// parts it had, null or false. So does a call on another thread.
class QNCORE_API CQuarnDoc {
public:
    CQuarnDoc(const CQuarnDoc&) = delete;
    CQuarnDoc& operator=(const CQuarnDoc&) = delete;

    /// The open document with this number, or null.
    static CQuarnDoc* FromRuntimeSerialNumber(unsigned int serial_number);
    /// A number from 1 that no other document of this run of the program ever has.
    unsigned int RuntimeSerialNumber() const;

    /// Fills the list with the document's views in their order.
    /// @param model_views  take the views of the model
    /// @param page_views   take the views of drawing sheets (this host has none)
    /// @return their number
    int GetViewList(KM_SimpleArray<CQuarnView*>& views, bool model_views, bool page_views) const;

    /// The distance, in document units, below which two points count as one.
    double AbsoluteTolerance() const;

    CQuarnDocProperties& Properties();
    CQuarnLightTable& LightTable();
    CQuarnSun& Sun();

    /// The first object with this name, ignoring case, or null. Owned by the document; valid until
    /// the document changes. A plug-in that wants to find it again keeps its id.
    const CQuarnObject* FindObjectByName(const wchar_t* name) const;

    /// Hides (shows) an object.
    /// @param ignore_modes  also when the object is locked
    /// @return true when its visibility changed; false for a reference to nothing and for an object
    ///         that was hidden (shown) already
    bool HideObject(const CQuarnObjRef& object, bool ignore_modes);
    bool ShowObject(const CQuarnObjRef& object, bool ignore_modes);

    /// Rebuilds display data that changed. A view's picture stays until its next redraw.
    void Regen();

private:
    friend class quarn::Document;
    explicit CQuarnDoc(quarn::Document& document) : m_document(&document) {}
    quarn::Document* m_document;
};
