# Turns host/look.properties into look.h, one documented struct; look_fields.h, the names and limits of its fields; and
# look.md, the table of docs/.
# embed_look(<properties file> <folder>)
function(embed_look properties folder)
    set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${properties})
    file(STRINGS ${properties} lines)
    set(members "")
    set(fields "")
    set(rows "")
    set(help "")
    set(number "-?[0-9]+(\\.[0-9]+)?")
    foreach(line IN LISTS lines)
        if(line MATCHES "^# range (${number} to ${number}), limits (${number}) to (${number})$")
            set(range "${CMAKE_MATCH_1}")
            set(least ${CMAKE_MATCH_4})
            set(most ${CMAKE_MATCH_6})
        elseif(line MATCHES "^# (.*)$")
            string(APPEND help "${CMAKE_MATCH_1}\n")
        elseif(line MATCHES "^([A-Za-z0-9]+) = (${number})$" AND DEFINED range)
            set(name ${CMAKE_MATCH_1})
            set(value ${CMAKE_MATCH_2})
            if(value MATCHES "\\.")
                set(member "float ${name} = ${value}f")
            else()
                set(member "int ${name} = ${value}")
            endif()
            string(REPLACE "\n" "\n    // " comment "${help}")
            string(APPEND members "    // ${comment}Range ${range}, limits ${least} to ${most}.\n    ${member};\n")
            string(APPEND fields "    {\"${name}\", &Look::${name}, ${least}, ${most}},\n")
            string(REPLACE "\n" " " cell "${help}")
            string(APPEND rows "| `${name}` | ${value} | ${range} | ${least} to ${most} | ${cell}|\n")
            set(help "")
            unset(range)
        elseif(line STREQUAL "")
            set(help "")
        else()
            message(FATAL_ERROR "${properties}: cannot read \"${line}\"")
        endif()
    endforeach()
    file(CONFIGURE OUTPUT ${folder}/look.h CONTENT "#pragma once\n\nstruct Look {\n${members}};\n" @ONLY)
    file(CONFIGURE OUTPUT ${folder}/look_fields.h CONTENT "\
#pragma once

#include <string_view>
#include <variant>

#include \"host/look.h\"

// A number of the look and what it keeps to.
struct LookField {
    std::string_view name;
    std::variant<int Look::*, float Look::*> member;
    double least, most;
};

inline constexpr LookField kLookFields[] = {
${fields}};
" @ONLY)
    configure_file(${CMAKE_CURRENT_FUNCTION_LIST_DIR}/look.md.in ${folder}/look.md @ONLY)
endfunction()
