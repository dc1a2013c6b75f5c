#include "host/look_limits.h"

#include <algorithm>
#include <type_traits>

#include "host/look_fields.h"

Look withinLimits(Look look) {
    for (const LookField& field : kLookFields) {
        const auto keep = [&](auto member) {
            auto& value = look.*member;
            using Number = std::remove_reference_t<decltype(value)>;
            const auto least = static_cast<Number>(field.least);
            value = value >= least ? std::min(value, static_cast<Number>(field.most)) : least;
        };
        std::visit(keep, field.member);
    }
    return look;
}
