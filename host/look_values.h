// The values of a look by their names, and the limits that they keep to.
#pragma once

#include <string_view>

#include "host/look_fields.h"

namespace tidemark {

// Null if there is none.
const LookField* fieldNamed(std::string_view name);

// False, and nothing changes, for a value that is not finite, beyond the field's limits, or a fraction where the field
// holds whole numbers.
bool setValue(Look& look, const LookField& field, double value);

// Null if all values are within their limits.
const LookField* firstInvalid(const Look& look);

}  // namespace tidemark
