# The game's twelve bitmaps and the program icon are made at build time by
# tools/vennick_bitmapgen from the art in tools/art and embedded in
# vennick_core, so every executable that links it finds ":/bitmaps/<id>.bmp"
# and ":/icons/vennick-<size>.png".

set(VENNICK_GENERATED_DIR ${CMAKE_BINARY_DIR}/generated)
set(VENNICK_BITMAP_IDS 130 132 133 134 135 161 162 163 164 165 166 200)
set(VENNICK_ICON_SIZES 16 32 48 64 128 256)

set(VENNICK_BITMAP_FILES)
foreach(id IN LISTS VENNICK_BITMAP_IDS)
    list(APPEND VENNICK_BITMAP_FILES ${VENNICK_GENERATED_DIR}/bitmaps/${id}.bmp)
endforeach()
# The icons, for the resources and for the install rules.
set(VENNICK_ICON_FILES)
foreach(size IN LISTS VENNICK_ICON_SIZES)
    list(APPEND VENNICK_ICON_FILES ${VENNICK_GENERATED_DIR}/icons/vennick-${size}.png)
endforeach()

# A change to the generator or to any art file draws everything again.
add_custom_command(
    OUTPUT ${VENNICK_BITMAP_FILES} ${VENNICK_ICON_FILES}
    COMMAND vennick_bitmapgen ${VENNICK_ART_DIR} ${VENNICK_GENERATED_DIR}
    DEPENDS vennick_bitmapgen ${VENNICK_ART_FILES}
    COMMENT "Drawing the bitmaps and the icon"
    VERBATIM)

qt_add_resources(vennick_core vennick_bitmaps
    PREFIX /bitmaps
    BASE ${VENNICK_GENERATED_DIR}/bitmaps
    FILES ${VENNICK_BITMAP_FILES})
qt_add_resources(vennick_core vennick_icons
    PREFIX /icons
    BASE ${VENNICK_GENERATED_DIR}/icons
    FILES ${VENNICK_ICON_FILES})

# How to Play, shown by Help as ":/help/how-to-play.html".
qt_add_resources(vennick_core vennick_help
    PREFIX /help
    BASE ${CMAKE_CURRENT_LIST_DIR}
    FILES ${CMAKE_CURRENT_LIST_DIR}/how-to-play.html)
