// String tables. Whatever the text, it is refused with a reason or gives texts with numbers above
// 0, which are found again in a table that is written from them.
#include "host/app/StringTables.h"
#include "kelmar/KM_wString.h"

#include <nlohmann/json.hpp>

#include <array>
#include <cstdint>
#include <cstdlib>
#include <string>

namespace {

using namespace quarn;

// A broken promise ends the program, which is how a fuzzer learns of it.
void require(bool promise) {
    if (!promise)
        std::abort();
}

std::string fileOf(const TextTable& table) {
    constexpr std::array names = {"strings", "option_names", "option_values"};
    nlohmann::json file = nlohmann::json::object();
    for (std::size_t space = 0; space < table.size(); ++space) {
        file[names[space]] = nlohmann::json::object();
        for (const auto& [id, text] : table[space])
            file[names[space]][std::to_string(id)] = KM_wString(text).ToUtf8();
    }
    return file.dump();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const Result<TextTable> table = readTextTable({reinterpret_cast<const char*>(bytes), size});
    if (!table) {
        require(!table.message().empty());
        return 0;
    }
    for (const auto& texts : table.value())
        require(texts.empty() || texts.begin()->first > 0);
    const Result<TextTable> again = readTextTable(fileOf(table.value()));
    require(again.ok() && again.value() == table.value());
    return 0;
}
