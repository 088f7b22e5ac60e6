#pragma once

#include "ground/Result.h"

#include <exception>
#include <type_traits>
#include <utility>

namespace quarn {

/// Calls into a plug-in. What it throws ends here and becomes an Error with its words.
template <class Call> auto acrossBorder(Call&& call) -> Result<std::invoke_result_t<Call>> {
    try {
        if constexpr (std::is_void_v<std::invoke_result_t<Call>>) {
            std::forward<Call>(call)();
            return {};
        } else {
            return std::forward<Call>(call)();
        }
    } catch (const std::exception& failure) {
        return Error{failure.what()};
    } catch (...) {
        return Error{"unknown error"};
    }
}

} // namespace quarn
