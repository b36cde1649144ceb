#include "frame/child/ListItem.h"

#include "frame/ClassTable.h"
#include "frame/Text.h"
#include "frame/child/ListView.h"

namespace tessel::child {

using frame::ControlError;
using frame::Status;
using frame::Variant;
namespace errors = frame::errors;

namespace {

constexpr std::int32_t lastSubItem = 32767;

int Column(std::int32_t subItem) {
    if (subItem < 1 || subItem > lastSubItem) throw ControlError(errors::invalidValue);
    return subItem;
}

std::int32_t IndexOf(ListRows::Position position) { return static_cast<std::int32_t>(position) + 1; }

}  // namespace

ListItem::ListItem(ListView& list, RowRef row) : list_(list), row_(row) {}

bool ListItem::IsOf(const ListView& list) const { return list_.Get() == &list; }

ListView& ListItem::List() const {
    ListView& list = *list_;
    if (!list.Rows().Lives(row_)) frame::ThrowObjectGone();
    return list;
}

ListRows& ListItem::Rows() const { return List().Rows(); }

std::string ListItem::Text() const { return Rows().Text(row_.row, 0); }
void ListItem::SetText(const std::string& value) { Rows().SetText(row_.row, 0, value); }
std::string ListItem::SubItems(std::int32_t index) const { return Rows().Text(row_.row, Column(index)); }
void ListItem::SetSubItems(std::int32_t index, const std::string& value) { Rows().SetText(row_.row, Column(index), value); }
std::string ListItem::Key() const { return Rows().Key(row_.row); }
Status ListItem::SetKey(const std::string& value) { return Rows().SetKey(row_.row, value); }
std::int32_t ListItem::Index() const { return IndexOf(Rows().PositionOf(row_.row)); }
Variant ListItem::Tag() const { return Rows().Tag(row_.row); }
void ListItem::SetTag(const Variant& value) { Rows().SetTag(row_.row, value); }
bool ListItem::Selected() const { return Rows().Selected(row_.row); }
void ListItem::SetSelected(bool value) { List().Select(row_.row, value); }
bool ListItem::Ghosted() const { return Rows().Ghosted(row_.row); }
void ListItem::SetGhosted(bool value) { Rows().SetGhosted(row_.row, value); }
Variant ListItem::Icon() const { return Rows().Icon(row_.row, IconSize::Large); }
Status ListItem::SetIcon(const Variant& value) { return Rows().SetIcon(row_.row, IconSize::Large, value); }
Variant ListItem::SmallIcon() const { return Rows().Icon(row_.row, IconSize::Small); }
Status ListItem::SetSmallIcon(const Variant& value) { return Rows().SetIcon(row_.row, IconSize::Small, value); }
float ListItem::Top() const { return List().RowTop(Rows().PositionOf(row_.row)); }

float ListItem::Height() const { return List().RowHeight(Rows().PositionOf(row_.row)); }
void ListItem::EnsureVisible() const { List().EnsureVisible(Rows().PositionOf(row_.row)); }

std::string ListItem::Path() const {
    const ListView* list = list_.Get();
    if (!list || !list->Rows().Lives(row_)) return {};
    return list->ListItems.Path() + "(" + frame::Decimal(Index()) + ")";
}

bool ListItem::EqualsObject(const frame::Object& other) const {
    const auto* item = dynamic_cast<const ListItem*>(&other);
    return item && item->row_ == row_ && item->list_.Get() == list_.Get();
}

std::int32_t ListItems::Count() const { return static_cast<std::int32_t>(list_.Rows().Count()); }

std::int32_t ListItems::Add(const std::string& text, const std::optional<std::string>& key, std::optional<std::int32_t> index) {
    ListRows& rows = list_.Rows();
    if (key && rows.FindKey(*key)) throw ControlError(errors::keyNotUnique);
    if (index && (*index < 1 || *index > Count() + 1)) throw ControlError(errors::indexOutOfBounds);
    const RowId row = rows.Add(text, index ? std::optional(static_cast<ListRows::Position>(*index - 1)) : std::nullopt);
    if (key) rows.SetKey(row, *key).Check();
    return IndexOf(rows.PositionOf(row));
}

ListItemRef ListItems::Item(const Variant& indexOrKey) const { return list_.ItemOf(RowOf(indexOrKey)); }
void ListItems::Remove(const Variant& indexOrKey) { list_.Rows().Remove(RowOf(indexOrKey)); }
void ListItems::Clear() { list_.Rows().Clear(); }

RowId ListItems::RowOf(const Variant& indexOrKey) const {
    if (!indexOrKey.IsString()) return At(indexOrKey.ToLong());
    const auto row = list_.Rows().FindKey(indexOrKey.Text());
    if (!row) throw ControlError(errors::elementNotFound);
    return *row;
}

RowId ListItems::At(std::int32_t index) const {
    if (index < 1 || index > Count()) throw ControlError(errors::indexOutOfBounds);
    return list_.Rows().At(static_cast<ListRows::Position>(index - 1));
}

std::string ListItems::Path() const { return list_.Path() + ".ListItems"; }

namespace {

constexpr std::array itemMembers = {
    frame::property<&ListItem::Text, &ListItem::SetText>("Text", "The text of the row."),
    frame::property<&ListItem::SubItems, &ListItem::SetSubItems>("SubItems", "The text of a further column, from 1."),
    frame::property<&ListItem::Key, &ListItem::SetKey>("Key", "The name of the row in its list; empty for none."),
    frame::property<&ListItem::Index>("Index", "The place of the row in its list, from 1."),
    frame::property<&ListItem::Tag, &ListItem::SetTag>("Tag", "Whatever the program keeps with the row."),
    frame::property<&ListItem::Selected, &ListItem::SetSelected>("Selected", "Whether the row is selected."),
    frame::property<&ListItem::Ghosted, &ListItem::SetGhosted>("Ghosted", "Whether the row is shown pale."),
    frame::property<&ListItem::Icon, &ListItem::SetIcon>("Icon", "The key or index of the row's large image."),
    frame::property<&ListItem::SmallIcon, &ListItem::SetSmallIcon>("SmallIcon", "The key or index of the row's small image."),
    frame::property<&ListItem::Top>("Top", "Top edge in twips of the list, as it is scrolled."),
    frame::property<&ListItem::Height>("Height", "Height in twips."),
    frame::method<&ListItem::EnsureVisible>("EnsureVisible", "Scrolls the list so that the row is in view."),
};
constexpr frame::ClassTable itemTable{.name = "ListItem", .members = itemMembers, .defaultMember = "Text"};

constexpr std::array itemsMembers = {
    frame::property<&ListItems::Count>("Count", "The number of rows."),
    frame::property<&ListItems::Item>("Item", "A row by its index, from 1, or its key."),
    frame::method<&ListItems::Add>("Add", "Adds a row and gives its index.", {"Text", "Key", "Index"}),
    frame::method<&ListItems::Remove>("Remove", "Removes a row by its index or key.", {"Index"}),
    frame::method<&ListItems::Clear>("Clear", "Removes all rows."),
};
constexpr frame::ClassTable itemsTable{.name = "ListItems", .members = itemsMembers, .defaultMember = "Item"};

}  // namespace

const frame::ClassTable& ListItem::Table() const { return itemTable; }
const frame::ClassTable& ListItems::Table() const { return itemsTable; }

}  // namespace tessel::child
