// Makes the game's bitmaps and the program icon from the art in tools/art.
//
//   vennick_bitmapgen <art folder> <output folder>
//
// writes <output>/bitmaps/<id>.bmp and <output>/icons/vennick-<size>.png.

#include "ArtFile.h"
#include "Generator.h"

#include <QImage>

#include <cstdio>
#include <filesystem>
#include <string>

namespace {

struct BitmapFile {
    int id;
    int bitsPerPixel;
};

bool WritePng(const Canvas& canvas, const std::string& path, std::string& error)
{
    QImage image(canvas.Width(), canvas.Height(), QImage::Format_ARGB32);
    for (int y = 0; y < canvas.Height(); ++y)
        for (int x = 0; x < canvas.Width(); ++x) {
            const Colour c = canvas.At(x, y);
            image.setPixel(x, y, qRgba(c.r, c.g, c.b, c.a));
        }
    if (!image.save(QString::fromStdString(path), "PNG")) {
        error = path + ": cannot write";
        return false;
    }
    return true;
}

int Fail(const std::string& message)
{
    std::fprintf(stderr, "vennick_bitmapgen: %s\n", message.c_str());
    return 1;
}

} // namespace

int main(int argc, char** argv)
{
    if (argc != 3)
        return Fail("usage: vennick_bitmapgen <art folder> <output folder>");
    const std::filesystem::path artFolder = argv[1];
    const std::filesystem::path output = argv[2];

    std::string error;
    ArtFile cards;
    ArtFile icon;
    if (!cards.Load((artFolder / "cards.txt").string(), error) || !icon.Load((artFolder / "icon.txt").string(), error))
        return Fail(error);

    std::error_code ec;
    std::filesystem::create_directories(output / "bitmaps", ec);
    std::filesystem::create_directories(output / "icons", ec);
    if (ec)
        return Fail(output.string() + ": " + ec.message());

    const Colour table = cards.Named("table");
    const std::pair<BitmapFile, Canvas> bitmaps[] = {
        {{166, 4}, MakeBoard(BoardLook::Normal, table)},
        {{200, 8}, MakeBoard(BoardLook::Wooden, table)},
        {{135, 8}, MakeBoard(BoardLook::Embossed, table)},
        {{130, 4}, MakeFace(cards, 1)},
        {{133, 4}, MakeFace(cards, 2)},
        {{134, 4}, MakeFace(cards, 3)},
        {{132, 4}, MakeFace(cards, 4)},
        {{164, 4}, MakeBack(cards)},
        {{161, 4}, MakeRankGlyphs(cards)},
        {{162, 4}, cards.Sprite("peg-player", 5, 5)},
        {{163, 4}, cards.Sprite("peg-opponent", 5, 5)},
        {{165, 4}, MakeDigits(cards)},
    };
    for (const auto& [file, canvas] : bitmaps) {
        const std::string path = (output / "bitmaps" / (std::to_string(file.id) + ".bmp")).string();
        if (!WriteBmp(canvas, file.bitsPerPixel, path, error))
            return Fail(error);
    }

    // The two drawn sizes, and whole-number enlargements of them for the rest.
    const Canvas& icon16 = icon.Sprite("icon-16", 16, 16);
    const Canvas& icon32 = icon.Sprite("icon-32", 32, 32);
    const std::pair<int, Canvas> icons[] = {
        {16, icon16}, {32, icon32}, {48, icon16.Scaled(3)}, {64, icon32.Scaled(2)},
        {128, icon32.Scaled(4)}, {256, icon32.Scaled(8)},
    };
    for (const auto& [size, canvas] : icons) {
        const std::string path = (output / "icons" / ("vennick-" + std::to_string(size) + ".png")).string();
        if (!WritePng(canvas, path, error))
            return Fail(error);
    }
    return 0;
}
