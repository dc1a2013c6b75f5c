// Deletes GL objects before they are made anew.
//
// When a context is lost, the members that named its objects keep the names, and the new context gives the same names
// out again. A name that two members hold is stale in one of them, so its object is left alone: better one object too
// many than another member's object deleted.
#pragma once

#include <GLES2/gl2.h>

#include <span>

enum class GlKind { program, shader, buffer, framebuffer, texture };

// A member that names an object. Objects that are made and deleted together form a group, which the log names after its
// first member that is no shader.
struct GlObject {
    const char* group;
    GlKind kind;
    GLuint* name;
};

// Deletes the objects of a group, if it has any, with a line in the log, and sets their names to 0. `all` are the
// members of the engine.
void deleteGroup(std::span<const GlObject> all, const char* group);
