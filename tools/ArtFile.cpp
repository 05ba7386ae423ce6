#include "ArtFile.h"

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <vector>

namespace {

[[noreturn]] void Fail(const std::string& message)
{
    std::fprintf(stderr, "%s\n", message.c_str());
    std::exit(1);
}

} // namespace

bool ArtFile::Load(const std::string& filePath, std::string& error)
{
    path = filePath;
    std::ifstream file(path);
    if (!file) {
        error = path + ": cannot read";
        return false;
    }

    std::string line;
    int lineNumber = 0;
    auto where = [&] { return path + ":" + std::to_string(lineNumber) + ": "; };

    std::string spriteName;
    std::vector<std::string> rows;
    auto finishSprite = [&]() -> bool {
        if (spriteName.empty())
            return true;
        if (rows.empty()) {
            error = where() + "sprite " + spriteName + " has no rows";
            return false;
        }
        const int w = static_cast<int>(rows[0].size());
        Canvas canvas(w, static_cast<int>(rows.size()), Colour{});
        for (size_t y = 0; y < rows.size(); ++y) {
            if (static_cast<int>(rows[y].size()) != w) {
                error = where() + "sprite " + spriteName + ": row " + std::to_string(y + 1) + " is not " +
                        std::to_string(w) + " wide";
                return false;
            }
            for (int x = 0; x < w; ++x) {
                auto found = byCharacter.find(rows[y][static_cast<size_t>(x)]);
                if (found == byCharacter.end()) {
                    error = where() + "sprite " + spriteName + ": no colour for '" + rows[y][static_cast<size_t>(x)] + "'";
                    return false;
                }
                canvas.Set(x, static_cast<int>(y), found->second);
            }
        }
        sprites[spriteName] = canvas;
        spriteName.clear();
        rows.clear();
        return true;
    };

    while (std::getline(file, line)) {
        ++lineNumber;
        if (!line.empty() && line.back() == '\r')
            line.pop_back();
        if (!spriteName.empty()) {
            if (!line.empty()) {
                rows.push_back(line);
                continue;
            }
            if (!finishSprite())
                return false;
            continue;
        }
        if (line.empty() || line[0] == '#')
            continue;

        std::istringstream words(line);
        std::string keyword;
        words >> keyword;
        if (keyword == "colour") {
            std::string character, name, first;
            words >> character >> name >> first;
            Colour c{0, 0, 0, 0};
            if (first != "none") {
                int r = -1, g = -1, b = -1;
                std::istringstream(first) >> r;
                words >> g >> b;
                if (r < 0 || r > 255 || g < 0 || g > 255 || b < 0 || b > 255 || !words) {
                    error = where() + "a colour needs red, green and blue from 0 to 255";
                    return false;
                }
                c = Rgb(r, g, b);
            }
            if (character.size() != 1 || name.empty() || byCharacter.count(character[0]) || byName.count(name)) {
                error = where() + "a colour needs one new character and a new name";
                return false;
            }
            byCharacter[character[0]] = c;
            byName[name] = c;
        } else if (keyword == "sprite") {
            words >> spriteName;
            if (spriteName.empty() || sprites.count(spriteName)) {
                error = where() + "a sprite needs a new name";
                return false;
            }
        } else {
            error = where() + "expected 'colour' or 'sprite'";
            return false;
        }
    }
    return finishSprite();
}

const Canvas& ArtFile::Sprite(const std::string& name) const
{
    auto found = sprites.find(name);
    if (found == sprites.end())
        Fail(path + ": no sprite " + name);
    return found->second;
}

const Canvas& ArtFile::Sprite(const std::string& name, int width, int height) const
{
    const Canvas& sprite = Sprite(name);
    if (sprite.Width() != width || sprite.Height() != height)
        Fail(path + ": sprite " + name + " must be " + std::to_string(width) + " x " + std::to_string(height));
    return sprite;
}

Colour ArtFile::Named(const std::string& name) const
{
    auto found = byName.find(name);
    if (found == byName.end())
        Fail(path + ": no colour " + name);
    return found->second;
}
