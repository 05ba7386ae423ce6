# The desktop entry, the AppStream metainfo and the icon in every size the
# build draws, where desktop environments and software centres look for them,
# all under the one application id.
set(VENNICK_APP_ID org.quorvan.Vennick)

install(FILES ${CMAKE_CURRENT_LIST_DIR}/${VENNICK_APP_ID}.desktop
        DESTINATION ${CMAKE_INSTALL_DATADIR}/applications)
install(FILES ${CMAKE_CURRENT_LIST_DIR}/${VENNICK_APP_ID}.metainfo.xml
        DESTINATION ${CMAKE_INSTALL_DATADIR}/metainfo)

foreach(icon IN LISTS VENNICK_ICON_FILES)
    get_filename_component(icon_name ${icon} NAME)
    if(NOT icon_name MATCHES "^vennick-([0-9]+)\\.png$")
        message(FATAL_ERROR "Icon file not named vennick-<size>.png: ${icon}")
    endif()
    install(FILES ${icon}
            DESTINATION ${CMAKE_INSTALL_DATADIR}/icons/hicolor/${CMAKE_MATCH_1}x${CMAKE_MATCH_1}/apps
            RENAME ${VENNICK_APP_ID}.png)
endforeach()
