#pragma once

#include "sdk/qncore/QnExport.h"

/// An opaque window of the front end; null where there is no window.
using HWND = struct QnFrontEndWindow*;

/// A window that dialogs can be owned by.
class QNCORE_API CWnd {
public:
    /// The window object for a window, or null for a null window. The front end owns it; it lives
    /// as long as the window.
    static CWnd* FromHandle(HWND window);

    explicit CWnd(HWND window = nullptr) : m_hWnd(window) {}
    virtual ~CWnd();
    CWnd(const CWnd&) = delete;
    CWnd& operator=(const CWnd&) = delete;

    HWND m_hWnd; ///< the window this object stands for
};
