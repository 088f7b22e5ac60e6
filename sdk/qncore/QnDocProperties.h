#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "sdk/qncore/QnExport.h"

namespace quarn {
class Document;
}

/// The settings of a document. The animation record is kept by the plug-in that registered its
/// dynamic-access object; these calls reach it through that object. On a closed document and on
/// another thread than the main one they are breaches of the interface, which are reported.
class QNCORE_API CQuarnDocProperties {
public:
    /// A copy of the animation record; a fresh record while no plug-in keeps one, and
    /// after a breach.
    KM_3dmAnimationProperties AnimationProperties() const;

    /// Hands the whole record to the plug-in that keeps it. Does nothing while there is none.
    void SetAnimationProperties(const KM_3dmAnimationProperties& properties);

private:
    friend class quarn::Document;
    explicit CQuarnDocProperties(quarn::Document& document) : m_document(&document) {}
    quarn::Document* m_document;
};
