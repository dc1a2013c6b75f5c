// Deletes GL objects before a set-up creates them again.
//
// After a context loss the members keep the names of its objects, and the new context assigns the same names again. If
// two members have the same name, one of them is stale, and it is unknown which. Such an object is not deleted: a leak
// is better than deleting an object that another member uses.
#pragma once

#include <GLES2/gl2.h>

#include <span>

enum class GlKind { program, shader, buffer, framebuffer, texture };

// Objects that are created and deleted together form a group. The group's key is the format of the line that is logged
// on deletion, with the name of the first object that is not a shader. Keys are compared by address: use the constants
// below, not literals.
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

struct GlObject {
    GlGroup group;
    GlKind kind;
    GLuint* name;  // points to the engine's member
};

// Deletes the objects of `group` and sets their names to 0. Logs one line if the group has objects. `all` lists every
// object of the engine.
void deleteGroup(std::span<const GlObject> all, GlGroup group);
