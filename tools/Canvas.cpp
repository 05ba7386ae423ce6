#include "Canvas.h"

#include <algorithm>
#include <cmath>
#include <fstream>

Colour Mix(Colour a, Colour b, double t)
{
    auto channel = [t](uint8_t x, uint8_t y) {
        return static_cast<uint8_t>(std::lround(x + (y - x) * std::clamp(t, 0.0, 1.0)));
    };
    return {channel(a.r, b.r), channel(a.g, b.g), channel(a.b, b.b), channel(a.a, b.a)};
}

Canvas::Canvas(int w, int h, Colour fill)
    : width(w), height(h), pixels(static_cast<size_t>(w) * static_cast<size_t>(h), fill)
{
}

void Canvas::Set(int x, int y, Colour c)
{
    if (Inside(x, y))
        pixels[Index(x, y)] = c;
}

void Canvas::FillRect(int left, int top, int right, int bottom, Colour c)
{
    for (int y = top; y < bottom; ++y)
        for (int x = left; x < right; ++x)
            Set(x, y, c);
}

void Canvas::Paste(const Canvas& source, int left, int top)
{
    for (int y = 0; y < source.height; ++y)
        for (int x = 0; x < source.width; ++x)
            Set(left + x, top + y, source.At(x, y));
}

void Canvas::Replace(Colour from, Colour to)
{
    std::replace(pixels.begin(), pixels.end(), from, to);
}

Canvas Canvas::Turned() const
{
    Canvas turned = *this;
    std::reverse(turned.pixels.begin(), turned.pixels.end());
    return turned;
}

Canvas Canvas::Scaled(int factor) const
{
    Canvas big(width * factor, height * factor, Colour{});
    for (int y = 0; y < big.height; ++y)
        for (int x = 0; x < big.width; ++x)
            big.pixels[big.Index(x, y)] = At(x / factor, y / factor);
    return big;
}

std::vector<Colour> Canvas::DistinctColours() const
{
    std::vector<Colour> colours;
    for (Colour c : pixels)
        if (std::find(colours.begin(), colours.end(), c) == colours.end())
            colours.push_back(c);
    return colours;
}

namespace {

void PutLe(std::string& out, uint32_t value, int bytes)
{
    for (int i = 0; i < bytes; ++i)
        out.push_back(static_cast<char>((value >> (8 * i)) & 0xFF));
}

} // namespace

bool WriteBmp(const Canvas& canvas, int bitsPerPixel, const std::string& path, std::string& error)
{
    if (bitsPerPixel != 4 && bitsPerPixel != 8) {
        error = path + ": only 4 and 8 bits per pixel are written";
        return false;
    }
    const std::vector<Colour> palette = canvas.DistinctColours();
    const size_t tableSize = size_t{1} << bitsPerPixel;
    if (palette.size() > tableSize) {
        error = path + ": " + std::to_string(palette.size()) + " colours do not fit " +
                std::to_string(bitsPerPixel) + " bits per pixel";
        return false;
    }
    for (Colour c : palette)
        if (c.a != 255) {
            error = path + ": a bitmap must be opaque";
            return false;
        }

    const uint32_t w = static_cast<uint32_t>(canvas.Width());
    const uint32_t h = static_cast<uint32_t>(canvas.Height());
    const uint32_t stride = (w * static_cast<uint32_t>(bitsPerPixel) + 31) / 32 * 4;
    const uint32_t offset = 14 + 40 + static_cast<uint32_t>(tableSize) * 4;
    const uint32_t imageSize = stride * h;

    std::string out;
    out += "BM";
    PutLe(out, offset + imageSize, 4);
    PutLe(out, 0, 4);  // two reserved words
    PutLe(out, offset, 4);

    PutLe(out, 40, 4);
    PutLe(out, w, 4);
    PutLe(out, h, 4);  // positive: rows run bottom-up
    PutLe(out, 1, 2);
    PutLe(out, static_cast<uint32_t>(bitsPerPixel), 2);
    PutLe(out, 0, 4);  // BI_RGB
    PutLe(out, imageSize, 4);
    PutLe(out, 2835, 4);  // 72 dpi
    PutLe(out, 2835, 4);
    PutLe(out, static_cast<uint32_t>(tableSize), 4);
    PutLe(out, 0, 4);

    for (size_t i = 0; i < tableSize; ++i) {
        const Colour c = i < palette.size() ? palette[i] : Colour{0, 0, 0, 0};
        out.push_back(static_cast<char>(c.b));
        out.push_back(static_cast<char>(c.g));
        out.push_back(static_cast<char>(c.r));
        out.push_back('\0');
    }

    for (int y = canvas.Height() - 1; y >= 0; --y) {
        std::string row(stride, '\0');
        for (int x = 0; x < canvas.Width(); ++x) {
            const auto index = static_cast<unsigned>(
                std::find(palette.begin(), palette.end(), canvas.At(x, y)) - palette.begin());
            if (bitsPerPixel == 8) {
                row[static_cast<size_t>(x)] = static_cast<char>(index);
            } else {
                const auto byte = static_cast<size_t>(x / 2);
                const unsigned shift = x % 2 == 0 ? 4 : 0;  // the left pixel is the high nibble
                row[byte] = static_cast<char>(static_cast<unsigned char>(row[byte]) | (index << shift));
            }
        }
        out += row;
    }

    std::ofstream file(path, std::ios::binary | std::ios::trunc);
    file.write(out.data(), static_cast<std::streamsize>(out.size()));
    if (!file) {
        error = path + ": cannot write";
        return false;
    }
    return true;
}
