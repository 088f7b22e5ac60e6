#include "host/commands/AnimationText.h"

#include "host/border/Border.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

namespace quarn {

namespace {

const wchar_t* kindText(KM_3dmAnimationProperties::CaptureTypes type) {
    switch (type) {
    case KM_3dmAnimationProperties::path:
        return L"camera path";
    case KM_3dmAnimationProperties::turntable:
        return L"turntable";
    case KM_3dmAnimationProperties::flythrough:
        return L"flythrough";
    case KM_3dmAnimationProperties::one_day_sun:
        return L"one-day sun study";
    case KM_3dmAnimationProperties::seasonal_sun:
        return L"seasonal sun study";
    case KM_3dmAnimationProperties::none:
        break;
    }
    return nullptr;
}

} // namespace

/// The record is looked at in place: a copy of its point lists may be long.
KM_wString animationText(Document& document) {
    const IQnZoetrixDynamicAccess* access = Zoetrix_QuarnDynamicAccess();
    if (!access)
        return {};
    const auto found = acrossBorder([&] { return &access->AnimationProperties(document.face()); });
    const wchar_t* kind = found ? kindText(found.value()->CaptureType()) : nullptr;
    if (!kind)
        return {};
    const KM_3dmAnimationProperties& record = *found.value();
    const KM_wString text = KM_wString::FormatToString(
        L"%s, %d %s in %s", kind, record.FrameCount(),
        record.FrameCount() == 1 ? L"frame" : L"frames", record.ViewportName().Array());
    const auto place = record.IsSunStudy() ? document.studiedPlace() : std::nullopt;
    return place ? text + L"; " + place->city + L", by the clocks of " + place->zone : text;
}

} // namespace quarn
