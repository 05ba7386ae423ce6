# The program's command line, run as a user runs it: the help and the version
# without any display, Qt's own options accepted, anything else refused with
# status 2 before a window is made (a window would keep it running until the
# timeout).
#   cmake -DPROGRAM=<the vennick executable> -DVERSION=<project version> -P CommandLine.cmake

unset(ENV{DISPLAY})
unset(ENV{WAYLAND_DISPLAY})
unset(ENV{QT_QPA_PLATFORM})

function(expect status stdout stderr)
    execute_process(COMMAND ${PROGRAM} ${ARGN} RESULT_VARIABLE got OUTPUT_VARIABLE out ERROR_VARIABLE err TIMEOUT 30)
    if(NOT got STREQUAL status OR NOT out MATCHES "${stdout}" OR NOT err MATCHES "${stderr}")
        message(SEND_ERROR "vennick ${ARGN}: status ${got}, expected ${status}\n"
                           "standard output:\n${out}\nstandard error:\n${err}")
    endif()
endfunction()

string(REPLACE "." "\\." version "${VERSION}")
expect(0 "^Vennick ${version}\n$" "" --version)
expect(0 "^Usage: [^\n]*vennick \\[options\\]\n.*--version" "" --help)
expect(0 "-platform <platformName\\[:options\\]>" "" --help-all)
expect(0 "^Vennick ${version}\n$" "" -platform offscreen --version)

set(ENV{QT_QPA_PLATFORM} offscreen)
expect(2 "^$" "vennick: Unknown option 'deal'\\.\nTry 'vennick --help' for more information\\.\n$" --deal)
expect(2 "^$" "vennick: Unexpected argument 'cards'\\.\n" cards)
