#pragma once

#include "kelmar/KM_Uuid.h"

#include <cstdint>
#include <set>
#include <span>

namespace quarn {

class Document;

/// Tells a person which objects of a document are not drawn because they are out of range, each of
/// them once.
class ObjectRangeWarning {
public:
    /// @param ids  all that are out of range; those of hidden objects wait until they are shown
    void tell(const Document& document, std::span<const KM_UUID> ids);

private:
    std::set<KM_UUID> m_told;
};

/// Tells a person that the camera of a view is out of range: once in each command, so once in a
/// recording however many of its frames see nothing, and without a command until it is in range
/// again.
class CameraRangeWarning {
public:
    /// @param is_in_range  whether the picture that was drawn just now shows the scene
    void tell(const Document& document, bool is_in_range);

private:
    bool m_is_told = false;
    std::uint64_t m_told_in = 0; ///< the number of the command
};

} // namespace quarn
