# Our own targets build with every common warning; Qt's strict string definitions keep
# every conversion between bytes and text explicit (the pages are windows-1255, the rest UTF-16).
function(zorbin_strict target)
    target_compile_options(${target} PRIVATE -Wall -Wextra -Wpedantic -Wshadow -Wnon-virtual-dtor
                                             -Wold-style-cast -Woverloaded-virtual)
    target_compile_definitions(${target} PRIVATE
        QT_NO_CAST_FROM_ASCII QT_NO_CAST_TO_ASCII QT_NO_URL_CAST_FROM_STRING
        QT_NO_FOREACH QT_NO_NARROWING_CONVERSIONS_IN_CONNECT)
endfunction()
