// Access to the values of a look by name, and their limits.
#pragma once

#include <string_view>

#include "host/look_fields.h"

namespace tidemark {

// Returns the field with this name, or null.
const LookField* fieldNamed(std::string_view name);

// Sets a value. Returns false and changes nothing if the value is not finite, is outside the field's limits, or is a
// fraction for an integer field.
bool setValue(Look& look, const LookField& field, double value);

// Returns the first field whose value is outside its limits, or null.
const LookField* firstInvalid(const Look& look);

}  // namespace tidemark
