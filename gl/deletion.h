// Deletes GL objects that the engine owns.
//
// When a context is lost, the engine's members keep names of objects that are gone, and the new context gives the same
// names out again. A name that two members hold is stale in one of them, so its object is left alone: better one object
// too many than another member's object deleted.
#pragma once

#include <GLES2/gl2.h>

class Fluid;
struct Surface_;

void deleteBuffer(const Fluid& engine, GLuint buffer);
void deleteTexture(const Fluid& engine, GLuint texture);
void deleteSurface(const Fluid& engine, const Surface_& surface);
void deleteShader(const Fluid& engine, GLuint shader);
void deleteProgram(const Fluid& engine, GLuint program);
