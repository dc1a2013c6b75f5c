#include "host/look_values.h"

#include <cmath>
#include <type_traits>

#include "host/look_fields.h"

namespace {

bool isWithin(const LookField& field, double value) {
    // Limits are compared as the members hold them: a float's 0.3 is a little more than 0.3.
    const auto as = [&field](double limit) {
        return std::holds_alternative<float Look::*>(field.member) ? double{static_cast<float>(limit)} : limit;
    };
    return as(value) >= as(field.least) && as(value) <= as(field.most);
}

}  // namespace

const LookField* fieldNamed(std::string_view name) {
    for (const LookField& field : kLookFields) {
        if (field.name == name) return &field;
    }
    return nullptr;
}

bool setValue(Look& look, const LookField& field, double value) {
    if (!isWithin(field, value)) return false;
    std::visit(
        [&](auto member) { look.*member = static_cast<std::remove_reference_t<decltype(look.*member)>>(value); },
        field.member);
    return true;
}

const LookField* firstInvalid(const Look& look) {
    for (const LookField& field : kLookFields) {
        const auto isInvalid = [&](auto member) { return !isWithin(field, static_cast<double>(look.*member)); };
        if (std::visit(isInvalid, field.member)) return &field;
    }
    return nullptr;
}
