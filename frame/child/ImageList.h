#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "frame/ChildControl.h"
#include "frame/Color.h"
#include "frame/Picture.h"
#include "frame/Text.h"
#include "frame/Variant.h"
#include "frame/child/RowIcons.h"

namespace tessel::child {

class ImageList;
class ImageListHolder;
class ListImages;

/// An image of an image list. It lives until it is removed; references to it by name are weak.
class ListImage final : public frame::Object {
  public:
    /// From 1.
    std::int32_t Index() const;
    /// Unique in its list without regard to case; empty for none. A new key is error 35602 where another image has it.
    const std::string& Key() const { return key_; }
    void SetKey(const std::string& value);
    const frame::Variant& Tag() const { return tag_; }
    void SetTag(const frame::Variant& value) { tag_ = value; }
    /// Never null: a set to null is error 481.
    const frame::PictureRef& Picture() const { return picture_; }
    void SetPicture(const frame::PictureRef& value);
    /// The picture as a screen shows it: where the list uses its mask colour, the pixels of that colour are clear. The same object
    /// until the image is shown otherwise, so that a peer may keep what it made of it.
    const frame::PictureRef& ShownPicture() const;

    const frame::ClassTable& Table() const override;
    /// With the key in quotes, or the index where there is none.
    std::string Path() const override;

  private:
    friend class ListImages;
    ListImage(ListImages& images, std::string key, frame::PictureRef picture);

    ListImages& images_;
    std::string key_;
    frame::Variant tag_;
    frame::PictureRef picture_;
    mutable frame::PictureRef shown_;  // made when asked
    mutable std::size_t place_ = 0;    // where it stood when last seen
};

/// The images of an image list as a collection. An image is named by its index from 1 or by its key, without regard to case: a
/// string is always a key. Error 35600 for an index outside, 35601 for a key that is not there.
class ListImages final : public frame::Object {
  public:
    explicit ListImages(ImageList& list) : list_(list) {}

    std::int32_t Count() const { return static_cast<std::int32_t>(images_.size()); }
    /// Adds an image behind all others, or so that it has the index given, from 1 to `Count` + 1 (error 35600 outside). The empty
    /// key is none, and any number of images may have none; error 35602 for a key that is there already. Error 481 without a
    /// picture.
    ListImage& Add(std::optional<std::int32_t> index, const std::optional<std::string>& key, const frame::PictureRef& picture);
    ListImage& Item(const frame::Variant& indexOrKey) const;
    void Remove(const frame::Variant& indexOrKey);
    void Clear();

    /// Null where `Item` fails, and for an empty value and 0: what a row or a header names as its icon.
    ListImage* Find(const frame::Variant& indexOrKey) const;
    /// The image under a key, in constant time; null when there is none.
    ListImage* FindKey(std::string_view key) const;
    /// The image that has this very picture, for a host that writes down where a picture comes from; null when there is none.
    ListImage* FindPicture(const frame::Picture& picture) const;

    const frame::ClassTable& Table() const override;
    std::string Path() const override;

  private:
    friend class ImageList;
    friend class ListImage;

    std::size_t PlaceOf(const ListImage& image) const;
    std::size_t PlaceAt(std::int32_t index) const;
    void RequireFree(const std::string& key, const ListImage* holder) const;
    void Reshow();

    ImageList& list_;
    std::vector<std::unique_ptr<ListImage>> images_;
    std::unordered_map<std::string, ListImage*, frame::HashNoCase, frame::EqualNoCase> ofKey_;
};

/// Pictures of one size under keys, for the rows, headers and nodes of other children. It is never seen itself; it has no peer.
/// Those who show its images bind to it by an `ImageListHolder`, which tells them of every change.
class ImageList final : public frame::ChildControl {
  public:
    ImageList(frame::Control& owner, std::string name) : ChildControl(owner, std::move(name)) {}
    ~ImageList() override;

    /// The size at which every image is shown, in pixels; 0 until the first image comes, which then gives its own. Only an empty
    /// list takes another, and none below 0: error 380.
    std::int16_t ImageWidth() const { return imageWidth_; }
    void SetImageWidth(std::int16_t value);
    std::int16_t ImageHeight() const { return imageHeight_; }
    void SetImageHeight(std::int16_t value);
    /// The colour whose pixels are clear when an image is shown. `ListImage.Picture` keeps them.
    frame::OLE_COLOR MaskColor() const { return maskColor_; }
    void SetMaskColor(frame::OLE_COLOR value);
    bool UseMaskColor() const { return useMaskColor_; }
    void SetUseMaskColor(bool value);
    /// The colour behind an image that is drawn by itself.
    frame::OLE_COLOR BackColor() const { return backColor_; }
    void SetBackColor(frame::OLE_COLOR value);

    child::ListImages& Images() { return ListImages; }

    /// The keys, as rows and headers see them.
    const KeySet& Keys() const { return keys_; }
    /// Another number after each change of what would be shown.
    std::uint32_t Revision() const { return revision_; }

    const frame::ClassTable& Table() const override;

    child::ListImages ListImages{*this};

  private:
    friend class child::ListImages;
    friend class ListImage;
    friend class child::ImageListHolder;

    class KeysOfImages final : public KeySet {
      public:
        explicit KeysOfImages(const ImageList& list) : list_(list) {}
        bool Has(std::string_view key) const override { return list_.ListImages.FindKey(key) != nullptr; }
        std::int32_t Count() const override { return list_.ListImages.Count(); }
        std::uint32_t Revision() const override { return list_.Revision(); }

      private:
        const ImageList& list_;
    };

    void TakeSize(const frame::Picture& picture);
    void ImagesChanged();

    KeysOfImages keys_{*this};
    std::vector<ImageListHolder*> holders_;
    std::uint32_t revision_ = 0;
    std::int16_t imageWidth_ = 0, imageHeight_ = 0;
    frame::OLE_COLOR maskColor_ = 0xC0C0C0;
    frame::OLE_COLOR backColor_ = frame::colors::windowBackground;
    bool useMaskColor_ = true;
};

/// One who shows images of a list. It hears of each change of the list; when the list goes it holds none and hears of that too.
class ImageListHolder {
  public:
    explicit ImageListHolder(std::function<void()> changed) : changed_(std::move(changed)) {}
    ImageListHolder(const ImageListHolder&) = delete;
    ImageListHolder& operator=(const ImageListHolder&) = delete;
    ~ImageListHolder() { Set(nullptr); }

    ImageList* Get() const { return list_; }
    /// Takes another list, or none; the holder is told by its caller, not by this.
    void Set(ImageList* list);

  private:
    friend class ImageList;
    std::function<void()> changed_;
    ImageList* list_ = nullptr;
};

/// The picture with the pixels of a colour (RGB) made clear, at every scale; a picture without pixels as it is.
frame::PictureRef WithMask(const frame::PictureRef& picture, frame::OLE_COLOR mask);

}  // namespace tessel::child

namespace tessel::frame {

/// An image list by reference, null for none: error 13 for an object of another class.
template <>
struct Conversion<child::ImageList*> {
    static constexpr VarType type = VarType::Object;
    static child::ImageList* From(const Variant& value);
    static Variant To(child::ImageList* value) { return value ? ObjectRef(*value) : ObjectRef(); }
};

}  // namespace tessel::frame
