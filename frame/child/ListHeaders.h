#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "frame/Object.h"
#include "frame/Text.h"
#include "frame/Variant.h"
#include "frame/child/Label.h"

namespace tessel::child {

class ColumnHeaders;
class ListView;

/// A column of a list in report view, with its header. Column 1 shows the text of the rows, column n their sub-item n - 1. It
/// lives until it is removed; references to it by name are weak.
class ColumnHeader final : public frame::Object {
  public:
    /// From 1, however the columns are moved.
    std::int32_t Index() const;
    /// The sub-item that the column shows; 0 for the text.
    std::int32_t SubItemIndex() const { return Index() - 1; }
    /// Where the column stands in view, from 1. A set moves it there, at most to the end: error 380 below 1.
    std::int32_t Position() const;
    void SetPosition(std::int32_t value);
    const std::string& Text() const { return text_; }
    void SetText(const std::string& value);
    /// In twips. A column of width 0 is never seen. A negative width becomes 0.
    float Width() const { return width_; }
    void SetWidth(float value);
    /// The left edge in twips, in a list that is not scrolled.
    float Left() const;
    /// Of the header and of the texts below it.
    AlignmentConstants Alignment() const { return alignment_; }
    void SetAlignment(AlignmentConstants value);
    /// The key or the index (from 1) of an image of the list's `ColumnHeaderIcons`; 0 and an empty value are none. Error 35601 for
    /// a key that the image list lacks, 35600 for such an index.
    const frame::Variant& Icon() const { return icon_; }
    frame::Status SetIcon(const frame::Variant& value);
    /// Unique in its list without regard to case; empty for none. A new key is error 35602 where another header has it.
    const std::string& Key() const { return key_; }
    void SetKey(const std::string& value);
    const frame::Variant& Tag() const { return tag_; }
    void SetTag(const frame::Variant& value) { tag_ = value; }

    const frame::ClassTable& Table() const override;
    std::string Path() const override;

  private:
    friend class ColumnHeaders;
    explicit ColumnHeader(ColumnHeaders& headers) : headers_(headers) {}

    template <class T>
    void Store(T& field, const T& value);

    ColumnHeaders& headers_;
    std::string text_, key_;
    float width_ = 0;
    AlignmentConstants alignment_ = AlignmentConstants::LeftJustify;
    frame::Variant icon_, tag_;
};

/// The column headers of a list as a collection. A header is named by its index from 1 or by its key, without regard to case: a
/// string is always a key. Error 35600 for an index outside, 35601 for a key that is not there.
class ColumnHeaders final : public frame::Object {
  public:
    static constexpr float newWidthTwips = 1440;

    explicit ColumnHeaders(ListView& list) : list_(list) {}

    std::int32_t Count() const { return static_cast<std::int32_t>(headers_.size()); }
    /// Adds a header behind all others, or so that it has the index given, from 1 to `Count` + 1 (error 35600 outside). What is
    /// not given is empty, the width `newWidthTwips`. Error 35602 for a key that is there already. A wrong icon is error 35601 or
    /// 35600, with the header added without one.
    ColumnHeader& Add(std::optional<std::int32_t> index = {}, const std::optional<std::string>& key = {},
                      const std::optional<std::string>& text = {}, std::optional<float> width = {},
                      std::optional<AlignmentConstants> alignment = {}, const std::optional<frame::Variant>& icon = {});
    ColumnHeader& Item(const frame::Variant& indexOrKey) const;
    void Remove(const frame::Variant& indexOrKey);
    void Clear();

    /// The header that stands at a place in view, from 1. Error 35600 outside.
    ColumnHeader& InView(std::int32_t position) const;
    /// Another number after each change of a header or of their order.
    std::uint32_t Revision() const { return revision_; }

    const frame::ClassTable& Table() const override;
    std::string Path() const override;

  private:
    friend class ColumnHeader;

    ColumnHeader* FindKey(std::string_view key) const;
    std::size_t PlaceOf(const ColumnHeader& header) const;
    std::size_t PlaceInView(const ColumnHeader& header) const;
    void RequireFree(const std::string& key, const ColumnHeader* holder) const;
    void MoveInView(const ColumnHeader& header, std::size_t place);
    void HeadersChanged();

    ListView& list_;
    std::vector<std::unique_ptr<ColumnHeader>> headers_;
    std::vector<ColumnHeader*> inView_;
    std::uint32_t revision_ = 0;
};

}  // namespace tessel::child
