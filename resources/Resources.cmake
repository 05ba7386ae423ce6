# (the generated bitmaps are added to vennick_core here)
