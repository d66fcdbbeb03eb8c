# etiquon_layer(target FOLDER dir [UI] SOURCES ... LINKS ...)
#
# Makes the library of one layer. Its headers are reached as "dir/header.h" through an include
# folder of its own that holds only a link to src/dir, and a library passes that folder on to
# those that link it. So a source sees the headers of its own layer and of the layers it links,
# and an include that goes up the arrows fails to build.
function(etiquon_layer target)
    cmake_parse_arguments(ARG "UI" "FOLDER" "SOURCES;LINKS" ${ARGN})
    add_library(${target} STATIC ${ARG_SOURCES})
    etiquon_expose_folder(${target} ${ARG_FOLDER})
    target_link_libraries(${target} PUBLIC ${ARG_LINKS})
    target_compile_definitions(${target} PUBLIC QT_NO_KEYWORDS)
    if(ARG_UI)
        set_target_properties(${target} PROPERTIES AUTOMOC ON)
        target_link_libraries(${target} PUBLIC Qt6::Gui Qt6::Widgets)
    else()
        target_link_libraries(${target} PUBLIC Qt6::Core)
    endif()
endfunction()

# Gives `target` (and what links it) the headers of src/<folder> as "<folder>/header.h".
function(etiquon_expose_folder target folder)
    set(root ${CMAKE_BINARY_DIR}/layers/${folder})
    if(NOT EXISTS ${root}/${folder})
        file(MAKE_DIRECTORY ${root})
        file(CREATE_LINK ${CMAKE_SOURCE_DIR}/src/${folder} ${root}/${folder} SYMBOLIC)
    endif()
    target_include_directories(${target} PUBLIC ${root})
endfunction()
