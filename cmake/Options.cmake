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

# A precompiled header for the rooms without widgets and one for all others. Every source compiles
# without them too: the preset "tidy" has none.
option(SONGCASE_PCH "Precompiled headers" ON)
file(WRITE ${CMAKE_BINARY_DIR}/pch.cpp "")
function(songcase_pch name library)
    add_library(${name} STATIC ${CMAKE_BINARY_DIR}/pch.cpp)
    target_link_libraries(${name} PUBLIC songcase_options ${library})
    if(SONGCASE_PCH)
        target_precompile_headers(${name} PRIVATE ${ARGN})
    endif()
    set_target_properties(${name} PROPERTIES AUTOMOC OFF AUTOUIC OFF AUTORCC OFF)
endfunction()
songcase_pch(songcase_pch Qt6::Widgets <QtCore> <QtWidgets>)
songcase_pch(songcase_core_pch Qt6::Core <QtCore>)

# songcase_tidy(): what this folder compiles from here on, clang-tidy reads first; both are done again only
# where a source or one of its headers has changed.
option(SONGCASE_TIDY "clang-tidy with each source of src" OFF)
function(songcase_tidy)
    if(SONGCASE_TIDY)
        find_program(CLANG_TIDY clang-tidy REQUIRED)
        file(SHA1 ${CMAKE_SOURCE_DIR}/.clang-tidy rules) # other rules are a reason to read all again
        set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${CMAKE_SOURCE_DIR}/.clang-tidy)
        # What moc and the resource compiler write is not ours to mend.
        file(WRITE ${CMAKE_BINARY_DIR}/.clang-tidy "Checks: '-*,readability-misleading-indentation'\n")
        set(CMAKE_CXX_CLANG_TIDY ${CLANG_TIDY} --quiet --warnings-as-errors=*
            --extra-arg=-DSONGCASE_TIDY_RULES=0x${rules} PARENT_SCOPE)
    endif()
endfunction()

# songcase_use_pch(TARGET PCH)
function(songcase_use_pch target pch)
    if(SONGCASE_PCH)
        target_precompile_headers(${target} REUSE_FROM ${pch})
    endif()
endfunction()

# songcase_room(NAME FOLDER [WIDGETS] LIBRARIES...): a library of all sources in a folder below src/.
function(songcase_room name folder)
    cmake_parse_arguments(PARSE_ARGV 2 room WIDGETS "" "")
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
    target_link_libraries(${name} PUBLIC songcase_options Qt6::Core ${room_UNPARSED_ARGUMENTS})
    if(room_WIDGETS)
        target_link_libraries(${name} PUBLIC Qt6::Widgets)
        songcase_use_pch(${name} songcase_pch)
    else()
        songcase_use_pch(${name} songcase_core_pch)
    endif()
endfunction()
