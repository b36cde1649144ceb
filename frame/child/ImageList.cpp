#include "frame/child/ImageList.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "frame/ClassTable.h"
#include "frame/Control.h"

namespace tessel::child {

using frame::ControlError;
using frame::Variant;
namespace errors = frame::errors;

ListImage::ListImage(ListImages& images, std::string key, frame::PictureRef picture)
    : images_(images), key_(std::move(key)), picture_(std::move(picture)) {}

std::int32_t ListImage::Index() const { return static_cast<std::int32_t>(images_.PlaceOf(*this)) + 1; }

void ListImage::SetKey(const std::string& value) {
    images_.RequireFree(value, this);
    if (!key_.empty()) images_.ofKey_.erase(key_);
    key_ = value;
    if (!key_.empty()) images_.ofKey_.emplace(key_, this);
    images_.list_.ImagesChanged();
}

void ListImage::SetPicture(const frame::PictureRef& value) {
    if (!value) throw ControlError(errors::invalidPicture);
    picture_ = value;
    shown_ = nullptr;
    images_.list_.ImagesChanged();
}

const frame::PictureRef& ListImage::ShownPicture() const {
    const ImageList& list = images_.list_;
    if (!list.UseMaskColor()) return picture_;
    if (!shown_) shown_ = WithMask(picture_, OleTranslateColor(list.MaskColor(), list.Host().Colors()));
    return shown_;
}

std::string ListImage::Path() const {
    return images_.Path() + "(" + (key_.empty() ? frame::Decimal(Index()) : "\"" + key_ + "\"") + ")";
}

ListImage& ListImages::Add(std::optional<std::int32_t> index, const std::optional<std::string>& key,
                           const frame::PictureRef& picture) {
    if (!picture) throw ControlError(errors::invalidPicture);
    const std::string newKey = key.value_or(std::string());
    RequireFree(newKey, nullptr);
    if (index && *index != Count() + 1) PlaceAt(*index);
    const std::size_t place = index ? static_cast<std::size_t>(*index - 1) : images_.size();

    const auto at = images_.insert(images_.begin() + static_cast<std::ptrdiff_t>(place),
                                   std::unique_ptr<ListImage>(new ListImage(*this, newKey, picture)));
    ListImage& image = **at;
    image.place_ = place;
    if (!newKey.empty()) ofKey_.emplace(newKey, &image);
    list_.TakeSize(*picture);
    list_.ImagesChanged();
    return image;
}

ListImage& ListImages::Item(const Variant& indexOrKey) const {
    if (!indexOrKey.IsString()) {
        const std::size_t place = PlaceAt(indexOrKey.ToLong());
        images_[place]->place_ = place;
        return *images_[place];
    }
    ListImage* image = FindKey(indexOrKey.Text());
    if (!image) throw ControlError(errors::elementNotFound);
    return *image;
}

void ListImages::Remove(const Variant& indexOrKey) {
    const ListImage& image = Item(indexOrKey);
    if (!image.key_.empty()) ofKey_.erase(image.key_);
    images_.erase(images_.begin() + static_cast<std::ptrdiff_t>(PlaceOf(image)));
    list_.ImagesChanged();
}

void ListImages::Clear() {
    ofKey_.clear();
    images_.clear();
    list_.ImagesChanged();
}

ListImage* ListImages::Find(const Variant& indexOrKey) const {
    if (indexOrKey.IsEmpty()) return nullptr;
    if (indexOrKey.IsString()) return FindKey(indexOrKey.Text());
    const std::int32_t index = indexOrKey.ToLong();
    return index >= 1 && index <= Count() ? images_[PlaceAt(index)].get() : nullptr;
}

ListImage* ListImages::FindKey(std::string_view key) const {
    const auto found = ofKey_.find(key);
    return found != ofKey_.end() ? found->second : nullptr;
}

ListImage* ListImages::FindPicture(const frame::Picture& picture) const {
    const auto found =
        std::find_if(images_.begin(), images_.end(), [&](const auto& image) { return image->Picture().get() == &picture; });
    return found != images_.end() ? found->get() : nullptr;
}

std::string ListImages::Path() const { return list_.Path() + ".ListImages"; }

std::size_t ListImages::PlaceOf(const ListImage& image) const {
    const auto isHere = [&](std::size_t place) { return place < images_.size() && images_[place].get() == &image; };
    if (!isHere(image.place_)) {
        const auto found = std::find_if(images_.begin(), images_.end(), [&](const auto& other) { return other.get() == &image; });
        image.place_ = static_cast<std::size_t>(found - images_.begin());
    }
    return image.place_;
}

std::size_t ListImages::PlaceAt(std::int32_t index) const {
    if (index < 1 || index > Count()) throw ControlError(errors::indexOutOfBounds);
    return static_cast<std::size_t>(index - 1);
}

void ListImages::RequireFree(const std::string& key, const ListImage* holder) const {
    const ListImage* other = FindKey(key);
    if (other && other != holder) throw ControlError(errors::keyNotUnique);
}

void ListImages::Reshow() {
    for (const auto& image : images_) image->shown_ = nullptr;
}

ImageList::~ImageList() {
    for (ImageListHolder* holder : std::exchange(holders_, {})) {
        holder->list_ = nullptr;
        holder->changed_();
    }
}

void ImageList::SetImageWidth(std::int16_t value) {
    if (value == imageWidth_) return;
    if (value < 0 || ListImages.Count() > 0) throw ControlError(errors::invalidValue);
    imageWidth_ = value;
    ImagesChanged();
}

void ImageList::SetImageHeight(std::int16_t value) {
    if (value == imageHeight_) return;
    if (value < 0 || ListImages.Count() > 0) throw ControlError(errors::invalidValue);
    imageHeight_ = value;
    ImagesChanged();
}

void ImageList::SetMaskColor(frame::OLE_COLOR value) {
    if (!Store(maskColor_, value)) return;
    ListImages.Reshow();
    ImagesChanged();
}

void ImageList::SetUseMaskColor(bool value) {
    if (Store(useMaskColor_, value)) ImagesChanged();
}

void ImageList::SetBackColor(frame::OLE_COLOR value) {
    if (Store(backColor_, value)) ImagesChanged();
}

void ImageList::TakeSize(const frame::Picture& picture) {
    const auto pixels = [](float twips) {
        constexpr float most = 32'767;
        return static_cast<std::int16_t>(std::clamp(std::round(twips / frame::twipsPerPixel), 1.0f, most));
    };
    if (imageWidth_ == 0) imageWidth_ = pixels(picture.Width());
    if (imageHeight_ == 0) imageHeight_ = pixels(picture.Height());
}

void ImageList::ImagesChanged() {
    ++revision_;
    Changed();
    for (const ImageListHolder* holder : holders_) holder->changed_();
}

void ImageListHolder::Set(ImageList* list) {
    if (list_ == list) return;
    if (list_) std::erase(list_->holders_, this);
    list_ = list;
    if (list_) list_->holders_.push_back(this);
}

frame::PictureRef WithMask(const frame::PictureRef& picture, frame::OLE_COLOR mask) {
    constexpr std::uint32_t rgbBits = 0xFFFFFFu;
    return MapPixels(picture, [&](std::uint32_t pixel) { return (pixel & rgbBits) == (mask.value & rgbBits) ? 0 : pixel; });
}

namespace {

constexpr std::array imageMembers = {
    frame::property<&ListImage::Index>("Index", "The place of the image in its list, from 1."),
    frame::property<&ListImage::Key, &ListImage::SetKey>("Key", "The name of the image in its list; empty for none."),
    frame::property<&ListImage::Tag, &ListImage::SetTag>("Tag", "Whatever the program keeps with the image."),
    frame::property<&ListImage::Picture, &ListImage::SetPicture>("Picture", "The picture."),
};
constexpr frame::ClassTable imageTable{.name = "ListImage", .members = imageMembers, .defaultMember = "Picture"};

constexpr std::array imagesMembers = {
    frame::property<&ListImages::Count>("Count", "The number of images."),
    frame::property<&ListImages::Item>("Item", "An image by its index, from 1, or its key."),
    frame::method<&ListImages::Add>("Add", "Adds an image and gives it.", {"Index", "Key", "Picture"}),
    frame::method<&ListImages::Remove>("Remove", "Removes an image by its index or key.", {"Index"}),
    frame::method<&ListImages::Clear>("Clear", "Removes all images."),
};
constexpr frame::ClassTable imagesTable{.name = "ListImages", .members = imagesMembers, .defaultMember = "Item"};

constexpr auto members = Join(
    frame::childMembers,
    std::array{
        frame::property<&ImageList::Images>("ListImages", "The images."),
        frame::property<&ImageList::ImageWidth, &ImageList::SetImageWidth>("ImageWidth", "The width of all images in pixels."),
        frame::property<&ImageList::ImageHeight, &ImageList::SetImageHeight>("ImageHeight", "The height of all images in pixels."),
        frame::property<&ImageList::MaskColor, &ImageList::SetMaskColor>("MaskColor", "The colour whose pixels are clear."),
        frame::property<&ImageList::UseMaskColor, &ImageList::SetUseMaskColor>("UseMaskColor",
                                                                               "Whether pixels of the mask colour are clear."),
        frame::property<&ImageList::BackColor, &ImageList::SetBackColor>("BackColor", "The colour behind an image."),
    });
constexpr frame::ClassTable listTable{.name = "ImageList", .members = members, .defaultMember = "ListImages"};

}  // namespace

const frame::ClassTable& ListImage::Table() const { return imageTable; }
const frame::ClassTable& ListImages::Table() const { return imagesTable; }
const frame::ClassTable& ImageList::Table() const { return listTable; }

}  // namespace tessel::child

namespace tessel::frame {

child::ImageList* Conversion<child::ImageList*>::From(const Variant& value) {
    const ObjectRef object = value.ToObject();
    if (object.IsNothing()) return nullptr;
    auto* list = dynamic_cast<child::ImageList*>(&*object);
    if (!list) throw ControlError(errors::typeMismatch);
    return list;
}

}  // namespace tessel::frame
