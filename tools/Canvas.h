#pragma once

#include <cstdint>
#include <string>
#include <vector>

// One pixel colour. Alpha only matters for the icon; bitmaps are opaque.
struct Colour {
    uint8_t r = 0;
    uint8_t g = 0;
    uint8_t b = 0;
    uint8_t a = 255;

    bool operator==(const Colour&) const = default;
};

constexpr Colour Rgb(int r, int g, int b)
{
    return {static_cast<uint8_t>(r), static_cast<uint8_t>(g), static_cast<uint8_t>(b), 255};
}

// Mixes a and b: t = 0 gives a, t = 1 gives b.
Colour Mix(Colour a, Colour b, double t);

// A picture in memory: the generator draws into it and writes it out.
class Canvas {
public:
    Canvas() = default;
    Canvas(int width, int height, Colour fill);

    int Width() const { return width; }
    int Height() const { return height; }
    bool Inside(int x, int y) const { return x >= 0 && y >= 0 && x < width && y < height; }

    Colour At(int x, int y) const { return pixels[Index(x, y)]; }
    void Set(int x, int y, Colour c);       // ignored outside
    void FillRect(int left, int top, int right, int bottom, Colour c);  // right, bottom exclusive
    void Paste(const Canvas& source, int left, int top);
    void Replace(Colour from, Colour to);
    Canvas Turned() const;                  // rotated by 180 degrees
    Canvas Scaled(int factor) const;        // each pixel becomes factor x factor
    std::vector<Colour> DistinctColours() const;

private:
    size_t Index(int x, int y) const { return static_cast<size_t>(y) * static_cast<size_t>(width) + static_cast<size_t>(x); }

    int width = 0;
    int height = 0;
    std::vector<Colour> pixels;
};

// Writes an uncompressed bottom-up device-independent bitmap (file header,
// 40-byte info header, a full colour table of 16 or 256 entries, rows padded
// to 4 bytes). Fails with a message when the canvas holds more colours than
// the depth can index or is not opaque.
bool WriteBmp(const Canvas& canvas, int bitsPerPixel, const std::string& path, std::string& error);
