#pragma once

#include "Canvas.h"

#include <map>
#include <string>

// Pixel art kept as text. A file declares named colours, each with the
// character that paints it, and then sprites drawn with those characters:
//
//   # a comment
//   colour . card 250 248 236      (character, name, red, green, blue)
//   colour - clear none            (a transparent colour, for the icon)
//   sprite heart-small             (the rows follow, up to a blank line)
//   .##.##.
//   ...
class ArtFile {
public:
    // Reads the file; on failure returns false with a message naming the line.
    bool Load(const std::string& path, std::string& error);

    bool HasSprite(const std::string& name) const { return sprites.count(name) != 0; }
    const Canvas& Sprite(const std::string& name) const;  // exits with a message if missing
    const Canvas& Sprite(const std::string& name, int width, int height) const;  // and if not this size
    Colour Named(const std::string& name) const;          // the same for colours

private:
    std::string path;
    std::map<char, Colour> byCharacter;
    std::map<std::string, Colour> byName;
    std::map<std::string, Canvas> sprites;
};
