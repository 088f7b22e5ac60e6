#include "import/assembly/EqualItems.h"

#include <gtest/gtest.h>

#include <map>
#include <random>

namespace quarn {
namespace {

TEST(EqualItems, EachItemLeadsToTheFirstOfAllThatEqualIt) {
    std::mt19937 random(11);
    for (const std::uint32_t kinds : {1U, 50U, 20'000U, 1'000'000U}) {
        std::vector<std::uint32_t> items(100'000);
        for (std::uint32_t& item : items)
            item = random() % kinds;
        // Many different items have one hash.
        const auto hash = [&](std::uint32_t i) { return items[i] / 3 * 2'654'435'761U; };
        const auto equals = [&](std::uint32_t a, std::uint32_t b) { return items[a] == items[b]; };
        std::vector<std::uint32_t> firsts(items.size());
        EqualItems(hash, equals).find(firsts);
        std::map<std::uint32_t, std::uint32_t> expected;
        for (std::uint32_t i = 0; i < items.size(); ++i)
            ASSERT_EQ(firsts[i], expected.emplace(items[i], i).first->second) << i;
    }
}

} // namespace
} // namespace quarn
