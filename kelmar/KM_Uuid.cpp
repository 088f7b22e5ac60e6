#include "kelmar/KM_Uuid.h"

#include <array>
#include <atomic>
#include <chrono>
#include <exception>
#include <random>

constinit const KM_UUID KM_nil_uuid;

namespace {

using Bytes = std::array<std::uint8_t, 16>; // in the order of the text

KM_UUID fromBytes(const Bytes& bytes) {
    KM_UUID id;
    for (int i = 0; i < 4; ++i)
        id.Data1 = (id.Data1 << 8) | bytes[static_cast<std::size_t>(i)];
    id.Data2 = static_cast<std::uint16_t>((bytes[4] << 8) | bytes[5]);
    id.Data3 = static_cast<std::uint16_t>((bytes[6] << 8) | bytes[7]);
    for (std::size_t i = 0; i < 8; ++i)
        id.Data4[i] = bytes[8 + i];
    return id;
}

int hexDigit(char character) {
    if (character >= '0' && character <= '9')
        return character - '0';
    if (character >= 'A' && character <= 'F')
        return character - 'A' + 10;
    if (character >= 'a' && character <= 'f')
        return character - 'a' + 10;
    return -1;
}

std::uint32_t randomBits() {
    try {
        // Kept, because opening the source takes much longer than reading it.
        thread_local std::random_device device;
        return device();
    } catch (const std::exception&) {
        // No entropy source. Time and a counter still make identifiers of one program differ.
        static std::atomic<std::uint32_t> counter = 0;
        const auto ticks = std::chrono::steady_clock::now().time_since_epoch().count();
        std::seed_seq seed{static_cast<std::uint32_t>(ticks),
                           static_cast<std::uint32_t>(ticks >> 32), ++counter};
        std::uint32_t bits = 0;
        seed.generate(&bits, &bits + 1);
        return bits;
    }
}

} // namespace

bool KM_UuidIsNil(const KM_UUID& id) {
    return id == KM_nil_uuid;
}

KM_UUID KM_UuidFromString(std::string_view text) {
    if (text.size() == 38 && text.front() == '{' && text.back() == '}')
        text = text.substr(1, 36);
    if (text.size() != 36)
        return KM_nil_uuid;
    Bytes bytes{};
    std::size_t digits = 0;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool dash_expected = i == 8 || i == 13 || i == 18 || i == 23;
        if (dash_expected && text[i] == '-')
            continue;
        const int digit = hexDigit(text[i]);
        if (dash_expected || digit < 0)
            return KM_nil_uuid;
        bytes[digits / 2] = static_cast<std::uint8_t>((bytes[digits / 2] << 4) | digit);
        ++digits;
    }
    return fromBytes(bytes);
}

KM_wString KM_UuidToString(const KM_UUID& id) {
    return KM_wString::FormatToString(L"%08X-%04X-%04X-%02X%02X-%02X%02X%02X%02X%02X%02X", id.Data1,
                                      id.Data2, id.Data3, id.Data4[0], id.Data4[1], id.Data4[2],
                                      id.Data4[3], id.Data4[4], id.Data4[5], id.Data4[6],
                                      id.Data4[7]);
}

KM_UUID KM_CreateUuid() {
    Bytes bytes;
    for (std::size_t i = 0; i < bytes.size(); i += 4) {
        const std::uint32_t bits = randomBits();
        for (std::size_t j = 0; j < 4; ++j)
            bytes[i + j] = static_cast<std::uint8_t>(bits >> (8 * j));
    }
    bytes[6] = static_cast<std::uint8_t>((bytes[6] & 0x0F) | 0x40); // version 4
    bytes[8] = static_cast<std::uint8_t>((bytes[8] & 0x3F) | 0x80); // the RFC's variant
    return fromBytes(bytes);
}
