#include "gl/objects.h"

#include <algorithm>

#include "base/log.h"

namespace {

bool isUniqueName(std::span<const GlObject> all, const GlObject& object) {
    return std::count_if(all.begin(), all.end(), [&object](const GlObject& other) {
               return other.kind == object.kind && *other.name == *object.name;
           }) == 1;
}

void deleteObject(GlKind kind, GLuint name) {
    switch (kind) {
        case GlKind::program:
            return glDeleteProgram(name);
        case GlKind::shader:
            return glDeleteShader(name);
        case GlKind::buffer:
            return glDeleteBuffers(1, &name);
        case GlKind::framebuffer:
            return glDeleteFramebuffers(1, &name);
        case GlKind::texture:
            return glDeleteTextures(1, &name);
    }
}

}  // namespace

void deleteGroup(std::span<const GlObject> all, GlGroup group) {
    const auto isInGroup = [group](const GlObject& object) { return object.group == group; };
    const auto first = std::find_if(all.begin(), all.end(), [&](const GlObject& object) {
        return isInGroup(object) && object.kind != GlKind::shader;
    });
    if (first == all.end() || !*first->name) return;
    LOG_INFO(group, *first->name);
    for (const GlObject& object : all) {
        if (!isInGroup(object)) continue;
        if (*object.name && isUniqueName(all, object)) deleteObject(object.kind, *object.name);
        *object.name = 0;
    }
}
