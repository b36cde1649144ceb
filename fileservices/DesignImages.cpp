#include "fileservices/DesignImages.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace tessel::fileservices::designimages {

namespace {

constexpr int grid = 16;  // what is drawn is measured in sixteenths of the side

// 0xAABBGGRR
constexpr std::uint32_t paleYellow = 0xFF9CE4FF, yellow = 0xFF5CC8F8, brown = 0xFF1E7AA8;
constexpr std::uint32_t paleGrey = 0xFFEEEEEE, grey = 0xFFC8C8C8, darkGrey = 0xFF707070;
constexpr std::uint32_t red = 0xFF2828D0, green = 0xFF30A030, blue = 0xFFB06820;

class Sketch {
  public:
    explicit Sketch(int side) : plane_{1, side, side, std::vector<std::uint32_t>(static_cast<std::size_t>(side * side))} {}

    void Box(int left, int top, int width, int height, std::uint32_t color) {
        for (int y = Pixel(top); y < Pixel(top + height); ++y)
            for (int x = Pixel(left); x < Pixel(left + width); ++x) At(x, y) = color;
    }
    /// A box with an outline one pixel wide, whatever the side.
    void Framed(int left, int top, int width, int height, std::uint32_t fill, std::uint32_t outline) {
        Box(left, top, width, height, outline);
        for (int y = Pixel(top) + 1; y < Pixel(top + height) - 1; ++y)
            for (int x = Pixel(left) + 1; x < Pixel(left + width) - 1; ++x) At(x, y) = fill;
    }
    /// Two bars crossed in a square, each two sixteenths wide.
    void Cross(int left, int top, int size, std::uint32_t color) {
        const int end = Pixel(size), thick = Pixel(2);
        for (int step = 0; step < end; ++step)
            for (int across = 0; across < thick && step + across < end; ++across) {
                At(Pixel(left) + step + across, Pixel(top) + step) = color;
                At(Pixel(left) + end - 1 - step - across, Pixel(top) + step) = color;
            }
    }
    enum class Points { Up, Down };
    void Triangle(int left, int top, int halfWidth, Points points, std::uint32_t color) {
        const int rows = Pixel(halfWidth);
        for (int row = 0; row < rows; ++row)
            for (int x = -row; x <= row; ++x)
                At(Pixel(left) + rows + x, Pixel(top) + (points == Points::Up ? row : rows - 1 - row)) = color;
    }
    frame::PictureRef Picture() && { return std::make_shared<frame::Picture>(std::vector{std::move(plane_)}, std::string()); }

  private:
    int Pixel(int sixteenths) const { return sixteenths * plane_.width / grid; }
    std::uint32_t& At(int x, int y) { return plane_.pixels[static_cast<std::size_t>(y * plane_.width + x)]; }

    frame::PixelPlane plane_;
};

void DrawFolder(Sketch& sketch, std::uint32_t body, std::uint32_t flap, std::uint32_t outline) {
    sketch.Framed(1, 2, 7, 4, flap, outline);
    sketch.Framed(1, 4, 14, 10, flap, outline);
    sketch.Framed(1, 6, 14, 8, body, outline);
}

void DrawComputer(Sketch& sketch) {
    sketch.Framed(1, 1, 14, 10, grey, darkGrey);
    sketch.Box(3, 3, 10, 6, blue);
    sketch.Box(6, 11, 4, 2, darkGrey);
    sketch.Framed(3, 13, 10, 2, grey, darkGrey);
}

void DrawDrive(Sketch& sketch) {
    sketch.Framed(1, 5, 14, 8, grey, darkGrey);
    sketch.Box(3, 7, 10, 1, paleGrey);
    sketch.Box(11, 10, 2, 1, green);
}

}  // namespace

frame::PictureRef Draw(std::string_view name, int side) {
    Sketch sketch(side);
    if (name == fileFolder) {
        DrawFolder(sketch, yellow, paleYellow, brown);
    } else if (name == folderUnavailable) {
        DrawFolder(sketch, grey, paleGrey, darkGrey);
        sketch.Cross(8, 8, 7, red);
    } else if (name == driveUnavailable) {
        DrawDrive(sketch);
        sketch.Cross(8, 8, 7, red);
    } else if (name == myComputer) {
        DrawComputer(sketch);
    } else if (name == myFolders) {
        DrawFolder(sketch, yellow, paleYellow, brown);
        sketch.Framed(7, 8, 7, 5, paleGrey, darkGrey);
        sketch.Box(9, 10, 3, 1, blue);
    } else if (name == sortUp) {
        sketch.Triangle(3, 6, 4, Sketch::Points::Up, darkGrey);
    } else if (name == sortDown) {
        sketch.Triangle(3, 6, 4, Sketch::Points::Down, darkGrey);
    }
    return std::move(sketch).Picture();
}

}  // namespace tessel::fileservices::designimages
