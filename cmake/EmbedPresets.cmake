# Turns host/presets.ini into presets.h, a table of C++; Preset.java, the same for Android; and presets.json for the web.
# embed_presets(<ini file> <folder>)
function(embed_presets ini folder)
    set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${ini})
    file(READ ${ini} text)
    string(REGEX REPLACE "#[^\n]*\n" "" text "${text}")
    # Semicolons separate a list's elements, and one in brackets would not end it.
    string(REGEX REPLACE "\n\\[([a-z-]+)\\]" ";\\1" text "${text}")
    list(POP_FRONT text)
    set(pattern "^([a-z-]+)\ntitle = ([A-Za-z ]+)\nground = ([a-z]+)\nink = (true|false)\nrain = (true|false)\n")
    foreach(section IN LISTS text)
        if(NOT section MATCHES "${pattern}")
            message(FATAL_ERROR "${ini}: cannot read \"${section}\"")
        endif()
        set(name ${CMAKE_MATCH_1})
        set(title "${CMAKE_MATCH_2}")
        set(ground ${CMAKE_MATCH_3})
        set(ink ${CMAKE_MATCH_4})
        set(rain ${CMAKE_MATCH_5})
        string(REGEX REPLACE "${pattern}" "" values "${section}")
        string(STRIP "${values}" values)
        set(form "([A-Za-z0-9]+) = ([0-9]+(\\.[0-9]+)?)")
        string(REGEX REPLACE "${form}" "\"\\1\": \\2" look "${values}")
        string(REPLACE "\n" ", " look "${look}")
        string(REGEX REPLACE "\": " "\", " java_values "${look}")
        set(pair "[^,]*, [^,]*, ")
        string(REGEX REPLACE "(${pair}${pair}${pair}[^,]*, [^,]*,) " "\\1\n            " java_values "${java_values}")
        string(APPEND json "${separator}\n    \"${name}\": {\"title\": \"${title}\", \"ground\": \"${ground}\", \
\"ink\": ${ink}, \"rain\": ${rain},\n        \"look\": {${look}}}")
        set(separator ",")
        string(REGEX REPLACE "(\\.[0-9]+)" "\\1f" values "${values}")
        string(REGEX REPLACE "([A-Za-z0-9]+ = [0-9.f]+)\n?" "look.\\1@\n" values "${values}")
        string(REPLACE "\n" "\n         " cpp_values "${values}")
        string(APPEND rows "    {\"${name}\", \"${title}\", Ground::${ground}, ${ink}, ${rain}, [] {\n         Look look@\n\
         ${cpp_values}return look@\n     }()},\n")
        string(TOUPPER "${name}" constant)
        string(REPLACE "-" "_" constant ${constant})
        string(APPEND constants "${java_separator}    /** ${title}. */
    ${constant}(\"${title}\", ${ink}, ${rain},
            ${java_values})")
        set(java_separator ",\n")
    endforeach()
    string(REPLACE "@" ";" rows "${rows}")
    file(CONFIGURE OUTPUT ${folder}/presets.h CONTENT "\
#pragma once

#include <string_view>

#include \"host/look.h\"

namespace tidemark {

// The picture under the water: tiles, pebbles or sand.
enum class Ground { pool, river, shore };

// A look with a name.
struct Preset {
    std::string_view name, title;
    Ground ground;
    bool ink, rain;
    Look look;
};

inline constexpr Preset kPresets[] = {
${rows}};

}  // namespace tidemark
" @ONLY)
    file(CONFIGURE OUTPUT ${folder}/presets.json CONTENT "{${json}\n}\n" @ONLY)
    configure_file(${CMAKE_CURRENT_FUNCTION_LIST_DIR}/Preset.java.in ${folder}/Preset.java @ONLY)
endfunction()
