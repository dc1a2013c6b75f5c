#include "host/look_values.h"

#include <algorithm>
#include <cmath>
#include <type_traits>

namespace tidemark {

const LookField* fieldNamed(std::string_view name) {
    const auto* const field = std::find_if(
        std::begin(kLookFields), std::end(kLookFields), [=](const LookField& f) { return f.name == name; });
    return field == std::end(kLookFields) ? nullptr : field;
}

bool setValue(Look& look, const LookField& field, double value) {
    const auto set = [&](auto member) {
        using Number = std::remove_reference_t<decltype(look.*member)>;
        // The nearest float to a limit may be beyond it.
        const double least = std::min(field.least, static_cast<double>(static_cast<Number>(field.least)));
        const double most = std::max(field.most, static_cast<double>(static_cast<Number>(field.most)));
        if (!(value >= least && value <= most)) return false;  // also rejects NaN
        if (std::is_integral_v<Number> && value != std::floor(value)) return false;
        look.*member = static_cast<Number>(value);
        return true;
    };
    return std::visit(set, field.member);
}

const LookField* firstInvalid(const Look& look) {
    Look copy;
    const auto* const field = std::find_if(std::begin(kLookFields), std::end(kLookFields), [&](const LookField& f) {
        const auto valueOf = [&](auto member) { return static_cast<double>(look.*member); };
        return !setValue(copy, f, std::visit(valueOf, f.member));
    });
    return field == std::end(kLookFields) ? nullptr : field;
}

}  // namespace tidemark
