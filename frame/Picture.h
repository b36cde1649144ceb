#pragma once

#include <cstdint>
#include <deque>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "frame/Object.h"

namespace tessel::frame {

/// The pixels of a picture at one scale, row by row, as 0xAABBGGRR: 0xFF in the high byte is opaque.
struct PixelPlane {
    double scale = 1;
    int width = 0;
    int height = 0;
    std::vector<std::uint32_t> pixels;
    friend bool operator==(const PixelPlane&, const PixelPlane&) = default;
};

/// A picture that does not change: its natural size, where it came from, and one pixel plane for each scale that it has.
class Picture final : public Object {
  public:
    Picture() = default;
    /// A picture of which only the size is known, in twips.
    Picture(float width, float height, std::string source) : width_(width), height_(height), source_(std::move(source)) {}
    Picture(std::vector<PixelPlane> planes, std::string source);
    /// A picture of this size in twips that is drawn at each scale when it is first wanted there.
    using Drawing = std::function<PixelPlane(double scale)>;
    Picture(float width, float height, Drawing drawing) : width_(width), height_(height), drawing_(std::move(drawing)) {}

    /// The natural size in twips: at scale 1 a pixel is 15 twips.
    float Width() const { return width_; }
    float Height() const { return height_; }
    /// The file that it was loaded from; empty for one that was drawn.
    const std::string& Source() const { return source_; }
    /// The plane of the least scale that is not below `scale`, else that of the greatest; null when there is none. A picture that
    /// is drawn has one of the scale itself, in quarters and up to 8.
    const PixelPlane* Plane(double scale) const;

    const ClassTable& Table() const override;
    bool EqualsObject(const Object& other) const override;

  private:
    friend std::shared_ptr<Picture> MapPixels(const std::shared_ptr<Picture>& picture,
                                              const std::function<std::uint32_t(std::uint32_t)>& map);

    float width_ = 0, height_ = 0;
    std::string source_;
    Drawing drawing_;
    mutable std::deque<PixelPlane>
        planes_;  // those of a picture that is drawn come when they are asked for, and stay where they are
};

using PictureRef = std::shared_ptr<Picture>;

/// The picture with every pixel changed, at every scale; one without pixels as it is.
PictureRef MapPixels(const PictureRef& picture, const std::function<std::uint32_t(std::uint32_t)>& map);

}  // namespace tessel::frame
