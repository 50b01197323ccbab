# Every folder under src/ is a static library of its own, and it sees only the headers of the
# libraries it declares: each library exports an include root that holds nothing but a link to
# its own folder. An #include of a folder the library does not depend on therefore fails to
# compile, and the layering cannot be crossed by accident.
#
#   zorbin_layer(<folder> [LAYERS <folders below it>...] [PUBLIC <targets>...] [PRIVATE <targets>...])
#
# makes the target zorbin-<folder> from the sources that the folder's CMakeLists adds to it.
set(ZORBIN_LAYER_TARGETS "" CACHE INTERNAL "")

# Lets `target` include the headers of the current folder as "<folder>/...", and nothing else.
function(zorbin_own_headers target folder scope)
    set(root ${CMAKE_BINARY_DIR}/layers/${folder})
    file(MAKE_DIRECTORY ${root})
    file(CREATE_LINK ${CMAKE_CURRENT_SOURCE_DIR} ${root}/${folder} SYMBOLIC)
    target_include_directories(${target} ${scope} ${root})
endfunction()

function(zorbin_layer folder)
    cmake_parse_arguments(arg "" "" "LAYERS;PUBLIC;PRIVATE" ${ARGN})
    set(target zorbin-${folder})
    add_library(${target} STATIC)
    zorbin_own_headers(${target} ${folder} PUBLIC)
    list(TRANSFORM arg_LAYERS PREPEND zorbin-)
    target_link_libraries(${target} PUBLIC ${arg_LAYERS} ${arg_PUBLIC} PRIVATE ${arg_PRIVATE})
    zorbin_strict(${target})
    set(ZORBIN_LAYER_TARGETS ${ZORBIN_LAYER_TARGETS} ${target} CACHE INTERNAL "")
endfunction()
