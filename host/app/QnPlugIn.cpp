#include "sdk/qncore/QnPlugIn.h"

#include "host/app/Application.h"
#include "host/app/PendingObjects.h"

namespace {

using Outcome = quarn::PlugInLoad::Outcome;

constexpr unsigned int UTILITY_PLUG_IN = 16;

int codeOf(Outcome outcome) {
    switch (outcome) {
    case Outcome::loaded:
        return 0;
    case Outcome::loaded_before:
        return 1;
    case Outcome::unknown_id:
        return -1;
    case Outcome::file_missing:
    case Outcome::not_a_library:
        return -2;
    case Outcome::exports_missing:
        return -3;
    case Outcome::version_mismatch:
        return -4;
    case Outcome::load_refused:
        return -5;
    }
    return -5;
}

} // namespace

CQuarnPlugIn::CQuarnPlugIn() {
    quarn::PendingObjects::announce(*this);
}

CQuarnPlugIn::~CQuarnPlugIn() {
    quarn::PendingObjects::forget(*this);
}

const wchar_t* CQuarnPlugIn::LocalPlugInName() const {
    return PlugInName();
}

CQuarnPlugIn::plugin_load_time CQuarnPlugIn::PlugInLoadTime() const {
    return load_when_needed;
}

bool CQuarnPlugIn::OnLoadPlugIn() {
    return true;
}

void CQuarnPlugIn::OnUnloadPlugIn() {}

bool CQuarnPlugIn::CallWriteDocument(const CQuarnFileWriteOptions&) {
    return false;
}

bool CQuarnPlugIn::WriteDocument(CQuarnDoc&, KM_BinaryArchive&, const CQuarnFileWriteOptions&) {
    return true;
}

bool CQuarnPlugIn::ReadDocument(CQuarnDoc&, KM_BinaryArchive&, const CQuarnFileReadOptions&) {
    return true;
}

bool CQuarnPlugIn::PlugInIsLoaded(const KM_UUID& id) {
    quarn::Application* application = quarn::Application::forCall("CQuarnPlugIn::PlugInIsLoaded");
    return application && application->plugIns().isLoaded(id);
}

int CQuarnPlugIn::LoadPlugIn(const KM_UUID& id, bool quietly, bool ignore_disabled) {
    quarn::Application* application = quarn::Application::forCall("CQuarnPlugIn::LoadPlugIn");
    if (!application)
        return codeOf(Outcome::unknown_id);
    quarn::Application::WithheldText text(*application);
    const quarn::PlugInLoad load = application->plugIns().loadById(id, ignore_disabled);
    // What a plug-in prints before it refuses is a reason too.
    if (load.ok() || !quietly)
        text.show();
    if (!load.ok() && !quietly)
        application->tell(load.message);
    return codeOf(load.outcome);
}

CQuarnUtilityPlugIn::CQuarnUtilityPlugIn() = default;

CQuarnUtilityPlugIn::~CQuarnUtilityPlugIn() = default;

unsigned int CQuarnUtilityPlugIn::PlugInType() const {
    return UTILITY_PLUG_IN;
}

CQuarnUtilitySystemPlugIn::CQuarnUtilitySystemPlugIn() = default;

CQuarnUtilitySystemPlugIn::~CQuarnUtilitySystemPlugIn() = default;
