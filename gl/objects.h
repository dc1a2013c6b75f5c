// Deletes GL objects before they are made anew.
//
// When a context is lost, the members that named its objects keep the names, and the new context gives the same names
// out again. A name that two members hold is stale in one of them, so its object is left alone: better one object too
// many than another member's object deleted.
#pragma once

#include <GLES2/gl2.h>

#include <span>

enum class GlKind { program, shader, buffer, framebuffer, texture };

// Objects that are made and deleted together form a group. Its key is the line that the log gets when the group is
// deleted, with the name of the first object that is not a shader. Keys are compared by address, so that only a
// constant below, and no literal with a typing error, names a group.
using GlGroup = const char*;
inline constexpr char kRippleProgram[] = "glDelete ripple_program = %u";
inline constexpr char kAdvectDensityProgram[] = "glDelete advect_density_program = %u";
inline constexpr char kAddInkProgram[] = "glDelete addInk_program = %u";
inline constexpr char kVelocityTarget[] = "glDelete Velocity.Ping.FboHandle = %u";
inline constexpr char kDensityTargets[] = "glDelete Density.Ping.FboHandle = %u";
inline constexpr char kQuadBuffer[] = "glDelete quadvbo = %u";
inline constexpr char kPositionBuffer[] = "glDelete v_buf = %u";
inline constexpr char kHeightBuffer[] = "glDelete h_buf = %u";
inline constexpr char kIndexBuffer[] = "glDelete i_buf = %u";
inline constexpr char kPortraitTexture[] = "glDelete portraitBG = %u";
inline constexpr char kLandscapeTexture[] = "glDelete landscapeBG = %u";
inline constexpr char kEnvironmentTexture[] = "glDelete environment = %u";

// A member that names an object.
struct GlObject {
    GlGroup group;
    GlKind kind;
    GLuint* name;
};

// Deletes the objects of a group, if it has any, with a line in the log, and sets their names to 0. `all` are the
// members of the engine.
void deleteGroup(std::span<const GlObject> all, GlGroup group);
