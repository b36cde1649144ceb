#include "frame/Picture.h"

#include <algorithm>
#include <cmath>
#include <iterator>

#include "frame/ClassTable.h"

namespace tessel::frame {

namespace {

constexpr float twipsPerPixel = 15;

constexpr std::array members = {
    property<&Picture::Width>("Width", "The natural width in twips."),
    property<&Picture::Height>("Height", "The natural height in twips."),
};
constexpr ClassTable table{.name = "Picture", .members = members};

}  // namespace

Picture::Picture(std::vector<PixelPlane> planes, std::string source)
    : source_(std::move(source)), planes_(std::make_move_iterator(planes.begin()), std::make_move_iterator(planes.end())) {
    std::sort(planes_.begin(), planes_.end(), [](const PixelPlane& a, const PixelPlane& b) { return a.scale < b.scale; });
    if (planes_.empty()) return;
    width_ = static_cast<float>(planes_.front().width / planes_.front().scale) * twipsPerPixel;
    height_ = static_cast<float>(planes_.front().height / planes_.front().scale) * twipsPerPixel;
}

const PixelPlane* Picture::Plane(double scale) const {
    if (drawing_) {
        constexpr double steps = 4, least = 1, most = 8;
        scale = scale > least ? std::min(std::ceil(scale * steps) / steps, most) : least;
        const auto drawn =
            std::find_if(planes_.begin(), planes_.end(), [&](const PixelPlane& plane) { return plane.scale == scale; });
        return drawn != planes_.end() ? &*drawn : &planes_.emplace_back(drawing_(scale));
    }
    if (planes_.empty()) return nullptr;
    const auto found = std::find_if(planes_.begin(), planes_.end(), [&](const PixelPlane& plane) { return plane.scale >= scale; });
    return found != planes_.end() ? &*found : &planes_.back();
}

bool Picture::EqualsObject(const Object& other) const {
    const auto* picture = dynamic_cast<const Picture*>(&other);
    if (picture && (picture->drawing_ || drawing_)) return picture == this;
    return picture && (picture == this || (picture->width_ == width_ && picture->height_ == height_ &&
                                           picture->source_ == source_ && picture->planes_ == planes_));
}

const ClassTable& Picture::Table() const { return table; }

PictureRef MapPixels(const PictureRef& picture, const std::function<std::uint32_t(std::uint32_t)>& map) {
    const auto mapped = [map](PixelPlane plane) {
        std::transform(plane.pixels.begin(), plane.pixels.end(), plane.pixels.begin(), map);
        return plane;
    };
    if (picture->drawing_)
        return std::make_shared<Picture>(picture->Width(), picture->Height(),
                                         [mapped, drawing = picture->drawing_](double scale) { return mapped(drawing(scale)); });
    if (picture->planes_.empty()) return picture;
    std::vector<PixelPlane> planes;
    std::transform(picture->planes_.begin(), picture->planes_.end(), std::back_inserter(planes), mapped);
    return std::make_shared<Picture>(std::move(planes), picture->source_);
}

}  // namespace tessel::frame
