#include "sdk/qncore/QnLocationDialog.h"

#include "host/app/Application.h"
#include "sdk/qncore/QnLocalize.h"

#include <cmath>

namespace {

/// Not for what is no number either.
bool isOnEarth(const quarn::Place& place) {
    return std::abs(place.latitude_deg) <= 90.0 && std::abs(place.longitude_deg) <= 180.0;
}

} // namespace

int QnShowLocationDialog(const wchar_t* title, double& latitude, double& longitude) {
    quarn::Application* application = quarn::Application::forCall("QnShowLocationDialog");
    if (!application)
        return QnDialogGivenUp;
    const quarn::Place given = {latitude, longitude};
    const quarn::Place start = isOnEarth(given) ? given : quarn::Place{};
    const auto chosen = application->frontEnd().chooseLocation(title ? title : L"", start);
    if (!chosen)
        return QnDialogGivenUp;
    if (!isOnEarth(*chosen)) {
        application->tell(KM_wString(QnLocalizeString(L"A place has a latitude from -90 to 90 and "
                                                      L"a longitude from -180 to 180.",
                                                      42416))
                              .ToUtf8());
        return QnDialogGivenUp;
    }
    latitude = chosen->latitude_deg;
    longitude = chosen->longitude_deg;
    return QnDialogConfirmed;
}
