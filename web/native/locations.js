// Replaces Emscripten's tables of locations. The library looks each location up by name in every frame, and its names are
// string constants: the address of the name is the location here, and WebGL is asked for it once in each program.
mergeInto(LibraryManager.library, {
    $known: function(program, address, find) {
        var locations = program.locations || (program.locations = new Map());
        var location = locations.get(address);
        if (location === undefined) locations.set(address, location = GLctx[find](program, UTF8ToString(address)));
        return location;
    },

    // WebGL ignores the value of a name that the program does not declare: its location is null.
    glGetUniformLocation: function(program, name) {
        return name;
    },
    $webglGetUniformLocation__deps: ['$known'],
    $webglGetUniformLocation: function(location) {
        return GLctx.currentProgram ? known(GLctx.currentProgram, location, 'getUniformLocation') : null;
    },

    glGetAttribLocation__deps: ['$known'],
    glGetAttribLocation: function(program, name) {
        return GL.programs[program] ? known(GL.programs[program], name, 'getAttribLocation') : -1;
    },
});
