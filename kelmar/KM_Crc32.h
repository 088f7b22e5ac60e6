#pragma once

#include "kelmar/KM_Export.h"

#include <cstdint>
#include <span>

/// The 32-bit frame check sequence of ISO/IEC 3309 and ITU-T V.42, section 8.1.1.6.2: polynomial
/// x^32 + x^26 + x^23 + x^22 + x^16 + x^12 + x^11 + x^10 + x^8 + x^7 + x^5 + x^4 + x^2 + x + 1,
/// lowest bit first, register and result inverted.
///
/// @param crc_before  the check sequence of the bytes that precede `bytes`; 0 when none do
KELMAR_API std::uint32_t KM_Crc32(std::span<const std::uint8_t> bytes,
                                  std::uint32_t crc_before = 0);
