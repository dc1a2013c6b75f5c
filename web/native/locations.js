// Replaces Emscripten's tables of uniform and attribute locations. The library looks up each location by name in every
// frame, and each name is a string constant. Its address serves as the location here, so WebGL is asked only once per
// name and program.
mergeInto(LibraryManager.library, {
    $known: function(program, address, find) {
        var locations = program.locations || (program.locations = new Map());
        var location = locations.get(address);
        if (location === undefined) locations.set(address, location = GLctx[find](program, UTF8ToString(address)));
        return location;
    },

    // If the program does not declare the name, the location is null and WebGL ignores the value.
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
