#pragma once

#include "kelmar/KM_Export.h"
#include "kelmar/KM_wString.h"

#include <compare>
#include <cstdint>
#include <string_view>

/// A universally unique identifier in its field form (RFC 4122, section 4.1.2). In text the
/// fields stand in order: Data1-Data2-Data3-Data4[0..1]-Data4[2..7].
struct KM_UUID {
    std::uint32_t Data1 = 0;
    std::uint16_t Data2 = 0;
    std::uint16_t Data3 = 0;
    std::uint8_t Data4[8] = {0, 0, 0, 0, 0, 0, 0, 0};

    /// Equality and order field by field, which is the order of the upper-case texts.
    friend bool operator==(const KM_UUID&, const KM_UUID&) = default;
    friend auto operator<=>(const KM_UUID&, const KM_UUID&) = default; // NOLINT: no null is there
};

/// The identifier whose bits are all zero: "no object".
extern KELMAR_API const KM_UUID KM_nil_uuid;

KELMAR_API bool KM_UuidIsNil(const KM_UUID& id);

/// Reads "6F1C9A3E-0B52-4D7E-9C1A-2E5F80B7D413" in either case, with or without braces around it.
/// @return the nil identifier when the text has any other form
KELMAR_API KM_UUID KM_UuidFromString(std::string_view text);

/// Upper-case text of 36 characters, without braces.
KELMAR_API KM_wString KM_UuidToString(const KM_UUID& id);

/// A new random identifier (RFC 4122, section 4.4: version 4), never nil. May be called from any
/// thread.
KELMAR_API KM_UUID KM_CreateUuid();
