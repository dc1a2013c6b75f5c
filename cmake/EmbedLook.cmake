# embed_look(<properties file> <folder>) generates from host/look.properties:
#   look.h         struct Look
#   look_fields.h  names and limits of its fields
#   Look.java      the same class for Android
#   look.json      names, values and ranges for the web page
#   look.md        the table of docs/look.md
function(embed_look properties folder)
    set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${properties})
    file(STRINGS ${properties} lines)
    foreach(list members fields java_members java_values rows json help)
        set(${list} "")
    endforeach()
    set(number "-?[0-9]+(\\.[0-9]+)?")
    foreach(line IN LISTS lines)
        if(line MATCHES "^# range (${number}) to (${number}), limits (${number}) to (${number})$")
            set(low ${CMAKE_MATCH_1})
            set(high ${CMAKE_MATCH_3})
            set(least ${CMAKE_MATCH_5})
            set(most ${CMAKE_MATCH_7})
        elseif(line MATCHES "^# (.*)$")
            string(APPEND help "${CMAKE_MATCH_1}\n")
        elseif(line MATCHES "^([A-Za-z0-9]+) = (${number})$" AND DEFINED low)
            set(name ${CMAKE_MATCH_1})
            set(value ${CMAKE_MATCH_2})
            if(value MATCHES "\\.")
                set(member "float ${name} = ${value}f")
                set(java_value "${name} = (float) values.next(\"${name}\", ${name}, ${least}f, ${most}f, false)")
                set(whole false)
            else()
                set(member "int ${name} = ${value}")
                set(java_value "${name} = (int) values.next(\"${name}\", ${name}, ${least}, ${most}, true)")
                set(whole true)
            endif()
            set(limits "Range ${low} to ${high}, limits ${least} to ${most}.")
            string(REPLACE "\n" "\n    // " comment "${help}")
            string(APPEND members "    // ${comment}${limits}\n    ${member};\n")
            string(APPEND fields "    {\"${name}\", &Look::${name}, ${least}, ${most}},\n")
            string(REPLACE "<" "&lt;" comment "${help}")
            string(REGEX MATCH "[^\n]*\n$" last_line "${comment}")
            string(LENGTH "     * ${last_line}${limits}" length)
            if(length LESS_EQUAL 120)
                string(REGEX REPLACE "\n$" " " comment "${comment}")
            endif()
            string(APPEND comment "${limits}")
            set(javadoc "    /** ${comment} */")
            string(LENGTH "${javadoc}" length)
            if(length GREATER 120 OR comment MATCHES "\n")
                string(REPLACE "\n" "\n     * " javadoc "    /**\n${comment}\n")
                string(REGEX REPLACE " $" "/" javadoc "${javadoc}")
            endif()
            string(APPEND java_members "${javadoc}\n    public ${member};\n")
            string(APPEND java_values "        ${java_value};\n")
            string(APPEND json "${separator}\n    {\"name\": \"${name}\", \"value\": ${value}, \"min\": ${low}, ")
            string(APPEND json "\"max\": ${high}, \"whole\": ${whole}}")
            set(separator ",")
            string(REPLACE "\n" " " cell "${help}")
            string(APPEND rows "| `${name}` | ${value} | ${low} to ${high} | ${least} to ${most} | ${cell}|\n")
            set(help "")
            unset(low)
        elseif(line STREQUAL "")
            set(help "")
        else()
            message(FATAL_ERROR "${properties}: cannot read \"${line}\"")
        endif()
    endforeach()
    file(CONFIGURE OUTPUT ${folder}/look.h CONTENT "\
#pragma once

namespace tidemark {
struct Look {
${members}};
}  // namespace tidemark
" @ONLY)
    file(CONFIGURE OUTPUT ${folder}/look_fields.h CONTENT "\
#pragma once

#include <string_view>
#include <variant>

#include \"host/look.h\"

namespace tidemark {

// A field of Look and its limits.
struct LookField {
    std::string_view name;
    std::variant<int Look::*, float Look::*> member;
    double least, most;
};

inline constexpr LookField kLookFields[] = {
${fields}};

}  // namespace tidemark
" @ONLY)
    file(CONFIGURE OUTPUT ${folder}/look.json CONTENT "[${json}\n]\n" @ONLY)
    configure_file(${CMAKE_CURRENT_FUNCTION_LIST_DIR}/look.md.in ${folder}/look.md @ONLY)
    configure_file(${CMAKE_CURRENT_FUNCTION_LIST_DIR}/Look.java.in ${folder}/Look.java @ONLY)
endfunction()
