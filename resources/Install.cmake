# (desktop entry and icons are installed here)
