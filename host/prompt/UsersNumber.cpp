#include "host/prompt/UsersNumber.h"

#include "host/prompt/NumberText.h"

#include <algorithm>

namespace quarn {

std::optional<double> readUsersNumber(std::wstring text) {
    std::ranges::replace(text, L',', L'.');
    return readNumber(text);
}

} // namespace quarn
