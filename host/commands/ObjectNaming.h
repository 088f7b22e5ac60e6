#pragma once

#include "host/document/ObjectTable.h"

#include <string>

namespace quarn {

/// Why an object cannot be called so: the name is empty, holds control characters, looks like an
/// id, or is another object's.
/// @param object  the object that is to get the name; null for a new one
/// @return a sentence for the person; empty when the object can be called so
std::string whyNameRefused(const ObjectTable& objects, const DocumentObject* object,
                           const KM_wString& name);

/// Six digits of a number, which is what a person reads.
std::string shortNumber(double number);

/// What a new object is, to be told: its name, kind, and length or place.
std::string newObjectText(const DocumentObject& object);

} // namespace quarn
