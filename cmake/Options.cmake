# What every target of ours is built with.
add_library(songcase_options INTERFACE)
target_include_directories(songcase_options INTERFACE ${CMAKE_SOURCE_DIR}/src)
target_compile_definitions(songcase_options INTERFACE
    QT_NO_CAST_FROM_ASCII QT_NO_CAST_TO_ASCII QT_NO_URL_CAST_FROM_STRING QT_NO_FOREACH
    QT_USE_QSTRINGBUILDER SONGCASE_VERSION="${PROJECT_VERSION}")
target_compile_options(songcase_options INTERFACE -Wall -Wextra -Wpedantic -Wnon-virtual-dtor -Woverloaded-virtual)
if(SONGCASE_WERROR)
    target_compile_options(songcase_options INTERFACE -Werror)
endif()
if(SONGCASE_SANITIZE)
    target_compile_options(songcase_options INTERFACE -fsanitize=address,undefined -fno-sanitize-recover=undefined -fno-omit-frame-pointer)
    target_link_options(songcase_options INTERFACE -fsanitize=address,undefined)
endif()

# One precompiled header for all that uses Qt.
file(WRITE ${CMAKE_BINARY_DIR}/pch.cpp "")
add_library(songcase_pch STATIC ${CMAKE_BINARY_DIR}/pch.cpp)
target_link_libraries(songcase_pch PUBLIC songcase_options Qt6::Widgets)
target_precompile_headers(songcase_pch PRIVATE <QtCore> <QtWidgets>)
set_target_properties(songcase_pch PROPERTIES AUTOMOC OFF AUTOUIC OFF AUTORCC OFF)

# songcase_room(NAME FOLDER DEPENDENCIES...): a library of all sources in a folder below src/.
function(songcase_room name folder)
    file(GLOB sources CONFIGURE_DEPENDS ${CMAKE_SOURCE_DIR}/src/${folder}/*.cpp
        ${CMAKE_SOURCE_DIR}/src/${folder}/*.h ${CMAKE_SOURCE_DIR}/src/${folder}/*.ui)
    # A header that is new to a build is not seen by AUTOMOC until its stamp is gone.
    set(known ${CMAKE_CURRENT_BINARY_DIR}/${name}.sources)
    if(EXISTS ${known})
        file(READ ${known} before)
    endif()
    if(NOT "${before}" STREQUAL "${sources}")
        file(REMOVE ${CMAKE_CURRENT_BINARY_DIR}/${name}_autogen/timestamp)
        file(WRITE ${known} "${sources}")
    endif()
    add_library(${name} STATIC ${sources})
    target_link_libraries(${name} PUBLIC songcase_options Qt6::Widgets ${ARGN})
    target_precompile_headers(${name} REUSE_FROM songcase_pch)
endfunction()
