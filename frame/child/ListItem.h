#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

#include "frame/Object.h"
#include "frame/child/ListRows.h"

namespace tessel::child {

class ListView;

/// A row of a list, named weakly: when the row or its list has gone every member fails with error 91. Two of them that name
/// the same row are equal.
class ListItem final : public frame::Object {
  public:
    ListItem(ListView& list, RowRef row);

    std::string Text() const;
    void SetText(const std::string& value);
    /// `index` from 1; error 380 below that and above 32767.
    std::string SubItems(std::int32_t index) const;
    void SetSubItems(std::int32_t index, const std::string& value);
    /// Unique in its list without regard to case; empty for none. Error 35602 for a key that another row has.
    std::string Key() const;
    frame::Status SetKey(const std::string& value);
    /// From 1, by the order as it stands.
    std::int32_t Index() const;
    frame::Variant Tag() const;
    void SetTag(const frame::Variant& value);
    bool Selected() const;
    /// Selecting makes the row the list's `SelectedItem`; without `MultiSelect` it takes the selection from all others.
    void SetSelected(bool value);
    bool Ghosted() const;
    void SetGhosted(bool value);
    /// The key or the index (from 1) of an image of the bound image list; empty for none. Error 35601 for a key that the list
    /// lacks, 35600 for such an index.
    frame::Variant Icon() const;
    frame::Status SetIcon(const frame::Variant& value);
    frame::Variant SmallIcon() const;
    frame::Status SetSmallIcon(const frame::Variant& value);
    /// In twips of the list, as the list is scrolled.
    float Top() const;
    float Height() const;
    /// Scrolls the list just so far that the row is in view.
    void EnsureVisible() const;

    RowRef Ref() const { return row_; }
    bool IsOf(const ListView& list) const;

    const frame::ClassTable& Table() const override;
    std::string Path() const override;
    bool EqualsObject(const frame::Object& other) const override;

  private:
    /// The list, when the row is still in it.
    ListView& List() const;
    ListRows& Rows() const;

    frame::Handle<ListView> list_;
    RowRef row_;
};

using ListItemRef = std::shared_ptr<ListItem>;

/// The rows of a list as a collection. A row is named by its index from 1 or by its key, without regard to case: a string is
/// always a key. Error 35600 for an index outside, 35601 for a key that is not there.
class ListItems final : public frame::Object {
  public:
    explicit ListItems(ListView& list) : list_(list) {}

    std::int32_t Count() const;
    /// Adds a row and gives its index: where it sorts; in a list that is not sorted with the index given, from 1 to `Count` + 1, or
    /// behind all others. Error 35600 for an index outside, 35602 for a key that is there already.
    std::int32_t Add(const std::string& text, const std::optional<std::string>& key = {}, std::optional<std::int32_t> index = {});
    ListItemRef Item(const frame::Variant& indexOrKey) const;
    void Remove(const frame::Variant& indexOrKey);
    void Clear();

    /// The row at an index.
    RowId At(std::int32_t index) const;

    const frame::ClassTable& Table() const override;
    std::string Path() const override;

  private:
    RowId RowOf(const frame::Variant& indexOrKey) const;

    ListView& list_;
};

}  // namespace tessel::child
