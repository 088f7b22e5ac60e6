#pragma once

#include <span>
#include <string_view>
#include <vector>

namespace layers {

/// A room: the sources below one place, and what they may include besides themselves.
struct Room {
    int floor;
    std::string_view place; ///< a path prefix of the including file

    /// Places of lower floors, or of rows above on the same one.
    std::vector<std::string_view> sees;
    /// Neighbours of the same floor that know each other through their headers.
    std::vector<std::string_view> neighbours = {};

    enum class Libraries { standard, any, standard_and_cocoa, any_and_cocoa };
    /// What it may include in angle brackets.
    Libraries libraries = Libraries::any;
    /// False where the files of a place share nothing but what `sees` names.
    bool knows_itself = true;
};

/// All rooms, the lowest first: a row names rows above it, and nothing else but its neighbours.
/// The first row whose place matches a file decides, so a narrower place stands before the wider.
std::span<const Room> floors();

} // namespace layers
