# stillmark_embed_icons(<target> <folder>): renders the SVGs that <folder>/icons.txt lists at both resolutions, packs
# them into the index and the stores of docs/files/icons.md, and compiles these into the target, as what IconResource()
# of framework/icons/iconResources.h answers. Each step runs again where what it reads has changed.
function(stillmark_embed_icons target folder)
    set(list "${folder}/icons.txt")
    set(out "${CMAKE_CURRENT_BINARY_DIR}/icons")
    file(MAKE_DIRECTORY "${out}/low" "${out}/high")
    set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS "${list}")

    set(listed)
    set(rendered)
    file(STRINGS "${list}" rows REGEX "^[^#]")
    foreach(row IN LISTS rows)
        string(REGEX REPLACE "[ \t]+" ";" columns "${row}")
        list(LENGTH columns count)
        if(NOT count EQUAL 7)
            message(FATAL_ERROR "${list}: a row has seven columns: ${row}")
        endif()
        list(GET columns 2 picture)
        list(GET columns 3 width)
        list(GET columns 4 height)
        if(picture IN_LIST listed)
            message(FATAL_ERROR "${list}: the picture ${picture} is there twice")
        endif()
        list(APPEND listed "${picture}")

        set(files)
        set(commands)
        foreach(resolution IN ITEMS low high)
            set(file "${out}/${resolution}/${picture}.png")
            list(APPEND files "${file}")
            list(APPEND commands COMMAND "${RSVG_CONVERT}" --width ${width} --height ${height} --output "${file}"
                "${folder}/${picture}.svg")
            math(EXPR width "2 * ${width}")
            math(EXPR height "2 * ${height}")
        endforeach()
        add_custom_command(OUTPUT ${files} ${commands}
            DEPENDS "${folder}/${picture}.svg"
            COMMENT "Rendering ${picture}.svg" VERBATIM)
        list(APPEND rendered ${files})
    endforeach()

    stillmark_glob(drawn RELATIVE ${folder} ${folder}/*.svg)
    foreach(file IN LISTS drawn)
        string(REGEX REPLACE "\\.svg$" "" picture "${file}")
        if(NOT picture IN_LIST listed)
            message(FATAL_ERROR "${list} does not list ${file}")
        endif()
    endforeach()

    set(packed "${out}/IconResources.idx" "${out}/IconsLowRes.dat" "${out}/IconsHighRes.dat")
    add_custom_command(OUTPUT ${packed}
        COMMAND stillmark_pack_icons "${list}" "${out}" "${out}"
        DEPENDS stillmark_pack_icons "${list}" ${rendered}
        COMMENT "Packing icons" VERBATIM)

    set(source "${out}/iconResources.cpp")
    set(script "${PROJECT_SOURCE_DIR}/cmake/writeIconSource.cmake")
    add_custom_command(OUTPUT "${source}"
        COMMAND "${CMAKE_COMMAND}" "-Dfolder=${out}" -P "${script}"
        DEPENDS ${packed} "${script}" VERBATIM)
    target_sources(${target} PRIVATE "${source}")
endfunction()
