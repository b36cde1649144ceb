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

float ListItem::Height() const {
    List();
    return ListView::rowHeightTwips;
}

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

std::int32_t ListItems::Add(const std::string& text) {
    ListRows& rows = list_.Rows();
    return IndexOf(rows.PositionOf(rows.Add(text)));
}

ListItemRef ListItems::Item(std::int32_t index) const { return list_.ItemOf(At(index)); }
void ListItems::Remove(std::int32_t index) { list_.Rows().Remove(At(index)); }
void ListItems::Clear() { list_.Rows().Clear(); }

RowId ListItems::At(std::int32_t index) const {
    if (index < 1 || index > Count()) throw ControlError(errors::indexOutOfBounds);
    return list_.Rows().At(static_cast<ListRows::Position>(index - 1));
}

std::string ListItems::Path() const { return list_.Path() + ".ListItems"; }

namespace {

constexpr std::array itemMembers = {
    frame::property<&ListItem::Text, &ListItem::SetText>("Text", "The text of the row."),
    frame::property<&ListItem::SubItems, &ListItem::SetSubItems>("SubItems", "The text of a further column, from 1."),
    frame::property<&ListItem::Index>("Index", "The place of the row in its list, from 1."),
    frame::property<&ListItem::Tag, &ListItem::SetTag>("Tag", "Whatever the program keeps with the row."),
    frame::property<&ListItem::Selected, &ListItem::SetSelected>("Selected", "Whether the row is selected."),
    frame::property<&ListItem::Ghosted, &ListItem::SetGhosted>("Ghosted", "Whether the row is shown pale."),
    frame::property<&ListItem::Icon, &ListItem::SetIcon>("Icon", "The key or index of the row's large image."),
    frame::property<&ListItem::SmallIcon, &ListItem::SetSmallIcon>("SmallIcon", "The key or index of the row's small image."),
    frame::property<&ListItem::Top>("Top", "Top edge in twips of the list, as it is scrolled."),
    frame::property<&ListItem::Height>("Height", "Height in twips."),
};
constexpr frame::ClassTable itemTable{.name = "ListItem", .members = itemMembers, .defaultMember = "Text"};

constexpr std::array itemsMembers = {
    frame::property<&ListItems::Count>("Count", "The number of rows."),
    frame::property<&ListItems::Item>("Item", "A row by its index, from 1."),
    frame::method<&ListItems::Add>("Add", "Adds a row and gives its index.", {"Text"}),
    frame::method<&ListItems::Remove>("Remove", "Removes the row at an index.", {"Index"}),
    frame::method<&ListItems::Clear>("Clear", "Removes all rows."),
};
constexpr frame::ClassTable itemsTable{.name = "ListItems", .members = itemsMembers, .defaultMember = "Item"};

}  // namespace

const frame::ClassTable& ListItem::Table() const { return itemTable; }
const frame::ClassTable& ListItems::Table() const { return itemsTable; }

}  // namespace tessel::child
