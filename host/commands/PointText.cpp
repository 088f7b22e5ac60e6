#include "host/commands/PointText.h"

#include "host/prompt/NumberText.h"

namespace quarn {

namespace {

Error noPoint(std::wstring_view text) {
    return Error{"\"" + KM_wString(text).ToUtf8() +
                 "\" is no point. Write x,y,z such as 10,-5.5,3."};
}

/// Cuts the text before the next comma off.
std::wstring_view takePart(std::wstring_view& rest) {
    const std::size_t comma = rest.find(L',');
    const std::wstring_view part = rest.substr(0, comma);
    rest = comma == std::wstring_view::npos ? std::wstring_view() : rest.substr(comma + 1);
    return part;
}

} // namespace

Result<KM_3dPoint> readPoint(std::wstring_view text) {
    std::wstring_view rest = text;
    const std::optional<double> x = readNumber(takePart(rest));
    const std::optional<double> y = readNumber(takePart(rest));
    const std::optional<double> z = readNumber(rest);
    if (!x || !y || !z)
        return noPoint(text);
    const KM_3dPoint point(*x, *y, *z);
    if (!point.IsValid())
        return noPoint(text);
    return point;
}

KM_wString pointText(const KM_3dPoint& point) {
    if (!point.IsValid())
        return {};
    return numberText(point.x) + L"," + numberText(point.y) + L"," + numberText(point.z);
}

} // namespace quarn
