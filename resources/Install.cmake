# The desktop entry and the icon in every size the build draws, where desktop
# environments look for them: share/applications and the hicolor theme.
install(FILES ${CMAKE_CURRENT_LIST_DIR}/vennick.desktop
        DESTINATION ${CMAKE_INSTALL_DATADIR}/applications)

foreach(icon IN LISTS VENNICK_ICON_FILES)
    get_filename_component(icon_name ${icon} NAME)
    if(NOT icon_name MATCHES "^vennick-([0-9]+)\\.png$")
        message(FATAL_ERROR "Icon file not named vennick-<size>.png: ${icon}")
    endif()
    install(FILES ${icon}
            DESTINATION ${CMAKE_INSTALL_DATADIR}/icons/hicolor/${CMAKE_MATCH_1}x${CMAKE_MATCH_1}/apps
            RENAME vennick.png)
endforeach()
