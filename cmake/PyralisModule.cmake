# pyr_module(<target> FILE <name.arx> SOURCES <files>... [DEPENDS <targets>...]): a module that a host
# loads, named as the host expects it, exporting nothing but acrxEntryPoint and acrxGetApiVersion, put
# beside the host programs.
function(pyr_module target)
    cmake_parse_arguments(ARG "" "FILE" "SOURCES;DEPENDS" ${ARGN})
    add_library(${target} SHARED ${ARG_SOURCES})
    get_filename_component(stem ${ARG_FILE} NAME_WE)
    get_filename_component(suffix ${ARG_FILE} LAST_EXT)
    set_target_properties(${target} PROPERTIES PREFIX "" OUTPUT_NAME ${stem} SUFFIX ${suffix}
                          LIBRARY_OUTPUT_DIRECTORY ${PYR_PROGRAM_DIR}
                          LINK_DEPENDS ${PROJECT_SOURCE_DIR}/cmake/module-exports.map)
    target_link_libraries(${target} PRIVATE pyr_hostrt ${ARG_DEPENDS})
    target_link_options(${target} PRIVATE -Wl,--version-script=${PROJECT_SOURCE_DIR}/cmake/module-exports.map)
endfunction()
