// The values of a look by their names, and what they keep to.
#pragma once

#include <string_view>

#include "host/look.h"

struct LookField;  // see look_fields.h, which the build writes

// Null where there is no such value.
const LookField* fieldNamed(std::string_view name);

// False, and the look stays as it is, for a value that is not a finite number within the field's limits.
bool setValue(Look& look, const LookField& field, double value);

// The first value beyond its limits, or null.
const LookField* firstInvalid(const Look& look);
