# add_toons(TARGET SOURCES TOONS): builds the Toon file of each JSON in one directory into another.
function(add_toons target sources toons)
    file(GLOB found CONFIGURE_DEPENDS ${sources}/*.json)
    file(MAKE_DIRECTORY ${toons})
    foreach(source ${found})
        cmake_path(GET source STEM name)
        set(toon ${toons}/${name}.zkt)
        add_custom_command(OUTPUT ${toon} COMMAND toon_tool write ${source} -o ${toon}
            DEPENDS toon_tool ${source} COMMENT "Writing ${name}.zkt" VERBATIM)
        list(APPEND built ${toon})
    endforeach()
    add_custom_target(${target} ALL DEPENDS ${built})
    set_target_properties(${target} PROPERTIES TOONS "${built}")
endfunction()

# The Toons that come with the program.
add_toons(toons ${PROJECT_SOURCE_DIR}/toons ${PROJECT_BINARY_DIR}/toons)

# use_toons(TARGET): DORBO_TOONS is the directory of the Toons that come with the program.
function(use_toons target)
    target_compile_definitions(${target} PRIVATE DORBO_TOONS="${PROJECT_BINARY_DIR}/toons")
    add_dependencies(${target} toons)
endfunction()
