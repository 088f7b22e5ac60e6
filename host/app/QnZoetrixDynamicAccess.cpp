#include "sdk/qncore/QnZoetrixDynamicAccess.h"

#include "host/border/Contract.h"

namespace {

/// The object that a plug-in installed. Kept apart from the application, because a plug-in removes
/// its object also when none runs any more.
IQnZoetrixDynamicAccess* installed_access = nullptr;

} // namespace

IQnZoetrixDynamicAccess::~IQnZoetrixDynamicAccess() = default;

void Zoetrix_SetQuarnDynamicAccess(IQnZoetrixDynamicAccess* access) {
    if (quarn::isOnMainThread("Zoetrix_SetQuarnDynamicAccess"))
        installed_access = access;
}

IQnZoetrixDynamicAccess* Zoetrix_QuarnDynamicAccess() {
    return quarn::isOnMainThread("Zoetrix_QuarnDynamicAccess") ? installed_access : nullptr;
}
