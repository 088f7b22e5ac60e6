#include "host/commands/ObjectNaming.h"

#include "host/commands/PointText.h"

#include <algorithm>
#include <array>
#include <charconv>

namespace quarn {

namespace {

bool isControl(wchar_t character) {
    return character < 32 || (character >= 127 && character < 160);
}

} // namespace

std::string shortNumber(double number) {
    std::array<char, 32> text{};
    const auto end = std::to_chars(text.data(), text.data() + text.size(), number,
                                   std::chars_format::general, 6);
    return {text.data(), end.ptr};
}

std::string whyNameRefused(const ObjectTable& objects, const DocumentObject* object,
                           const KM_wString& name) {
    if (name.IsEmpty())
        return "The name of an object cannot be empty.";
    if (std::ranges::any_of(name.View(), isControl))
        return "The name of an object cannot hold control characters.";
    if (!KM_UuidIsNil(KM_UuidFromString(name.ToUtf8())))
        return "The name of an object cannot look like an id.";
    const DocumentObject* owner = objects.findByName(name.View());
    if (owner && owner != object)
        return "Another object is called \"" + owner->name.ToUtf8() + "\"; give a free name.";
    return {};
}

std::string newObjectText(const DocumentObject& object) {
    const std::string name = object.name.ToUtf8() + ": ";
    if (object.point)
        return name + "point at " + pointText(*object.point).ToUtf8() + ".";
    if (!object.curve)
        return name + KM_wString(object.kind()).ToUtf8() + ".";
    double length = 0.0;
    object.curve->GetLength(&length);
    return name + KM_wString(object.curve->TypeName()).ToUtf8() +
           (object.curve->IsClosed() ? ", closed, length " : ", length ") + shortNumber(length) +
           ".";
}

} // namespace quarn
