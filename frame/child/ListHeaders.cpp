#include "frame/child/ListHeaders.h"

#include <algorithm>

#include "frame/ClassTable.h"
#include "frame/child/ListView.h"

namespace tessel::child {

using frame::ControlError;
using frame::Status;
using frame::Variant;
namespace errors = frame::errors;

template <class T>
void ColumnHeader::Store(T& field, const T& value) {
    if (field == value) return;
    field = value;
    headers_.HeadersChanged();
}

std::int32_t ColumnHeader::Index() const { return static_cast<std::int32_t>(headers_.PlaceOf(*this)) + 1; }
std::int32_t ColumnHeader::Position() const { return static_cast<std::int32_t>(headers_.PlaceInView(*this)) + 1; }

void ColumnHeader::SetPosition(std::int32_t value) {
    if (value < 1) throw ControlError(errors::invalidValue);
    headers_.MoveInView(*this, static_cast<std::size_t>(std::min(value, headers_.Count()) - 1));
}

void ColumnHeader::SetText(const std::string& value) { Store(text_, value); }
void ColumnHeader::SetWidth(float value) { Store(width_, value > 0 ? value : 0); }
void ColumnHeader::SetAlignment(AlignmentConstants value) { Store(alignment_, value); }

float ColumnHeader::Left() const {
    float left = 0;
    for (const ColumnHeader* header : headers_.inView_) {
        if (header == this) break;
        left += header->width_;
    }
    return left;
}

Status ColumnHeader::SetIcon(const Variant& value) {
    const bool isNone = value.IsEmpty() || (!value.IsString() && value.ToLong() == 0);
    const ImageList* images = headers_.list_.ColumnHeaderIcons();
    if (!isNone && (!images || !images->ListImages.Find(value)))
        return value.IsString() ? errors::elementNotFound : errors::indexOutOfBounds;
    Store(icon_, isNone ? Variant() : value);
    return {};
}

void ColumnHeader::SetKey(const std::string& value) {
    headers_.RequireFree(value, this);
    key_ = value;
}

std::string ColumnHeader::Path() const { return headers_.Path() + "(" + frame::Decimal(Index()) + ")"; }

ColumnHeader& ColumnHeaders::Add(std::optional<std::int32_t> index, const std::optional<std::string>& key,
                                 const std::optional<std::string>& text, std::optional<float> width,
                                 std::optional<AlignmentConstants> alignment, const std::optional<Variant>& icon) {
    const std::string newKey = key.value_or(std::string());
    RequireFree(newKey, nullptr);
    const std::int32_t newIndex = index.value_or(Count() + 1);
    if (newIndex < 1 || newIndex > Count() + 1) throw ControlError(errors::indexOutOfBounds);

    auto added = std::unique_ptr<ColumnHeader>(new ColumnHeader(*this));
    ColumnHeader& header = *added;
    header.key_ = newKey;
    header.text_ = text.value_or(std::string());
    header.width_ = width.value_or(newWidthTwips) > 0 ? width.value_or(newWidthTwips) : 0;
    header.alignment_ = alignment.value_or(AlignmentConstants::LeftJustify);
    headers_.insert(headers_.begin() + (newIndex - 1), std::move(added));
    inView_.insert(inView_.begin() + (newIndex - 1), &header);
    HeadersChanged();
    if (icon) header.SetIcon(*icon).Check();
    return header;
}

ColumnHeader& ColumnHeaders::Item(const Variant& indexOrKey) const {
    if (indexOrKey.IsString()) {
        ColumnHeader* header = FindKey(indexOrKey.Text());
        if (!header) throw ControlError(errors::elementNotFound);
        return *header;
    }
    const std::int32_t index = indexOrKey.ToLong();
    if (index < 1 || index > Count()) throw ControlError(errors::indexOutOfBounds);
    return *headers_[static_cast<std::size_t>(index - 1)];
}

void ColumnHeaders::Remove(const Variant& indexOrKey) {
    ColumnHeader& header = Item(indexOrKey);
    std::erase(inView_, &header);
    headers_.erase(headers_.begin() + static_cast<std::ptrdiff_t>(PlaceOf(header)));
    HeadersChanged();
}

void ColumnHeaders::Clear() {
    inView_.clear();
    headers_.clear();
    HeadersChanged();
}

ColumnHeader& ColumnHeaders::InView(std::int32_t position) const {
    if (position < 1 || position > Count()) throw ControlError(errors::indexOutOfBounds);
    return *inView_[static_cast<std::size_t>(position - 1)];
}

std::string ColumnHeaders::Path() const { return list_.Path() + ".ColumnHeaders"; }

ColumnHeader* ColumnHeaders::FindKey(std::string_view key) const {
    if (key.empty()) return nullptr;
    const auto found =
        std::find_if(headers_.begin(), headers_.end(), [&](const auto& header) { return frame::EqualsNoCase(header->key_, key); });
    return found != headers_.end() ? found->get() : nullptr;
}

std::size_t ColumnHeaders::PlaceOf(const ColumnHeader& header) const {
    const auto found = std::find_if(headers_.begin(), headers_.end(), [&](const auto& other) { return other.get() == &header; });
    return static_cast<std::size_t>(found - headers_.begin());
}

std::size_t ColumnHeaders::PlaceInView(const ColumnHeader& header) const {
    return static_cast<std::size_t>(std::find(inView_.begin(), inView_.end(), &header) - inView_.begin());
}

void ColumnHeaders::RequireFree(const std::string& key, const ColumnHeader* holder) const {
    const ColumnHeader* other = FindKey(key);
    if (other && other != holder) throw ControlError(errors::keyNotUnique);
}

void ColumnHeaders::MoveInView(const ColumnHeader& header, std::size_t place) {
    const auto from = inView_.begin() + static_cast<std::ptrdiff_t>(PlaceInView(header));
    const auto to = inView_.begin() + static_cast<std::ptrdiff_t>(place);
    if (from == to) return;
    if (from < to)
        std::rotate(from, from + 1, to + 1);
    else
        std::rotate(to, from, from + 1);
    HeadersChanged();
}

void ColumnHeaders::HeadersChanged() {
    ++revision_;
    list_.Refresh();
}

namespace {

constexpr std::array headerMembers = {
    frame::property<&ColumnHeader::Text, &ColumnHeader::SetText>("Text", "The text of the header."),
    frame::property<&ColumnHeader::Width, &ColumnHeader::SetWidth>("Width", "The width in twips; 0 hides the column."),
    frame::property<&ColumnHeader::Alignment, &ColumnHeader::SetAlignment>("Alignment", "Where the texts stand in the column."),
    frame::property<&ColumnHeader::Icon, &ColumnHeader::SetIcon>("Icon", "The key or index of the header's image."),
    frame::property<&ColumnHeader::Key, &ColumnHeader::SetKey>("Key", "The name of the header in its list; empty for none."),
    frame::property<&ColumnHeader::Tag, &ColumnHeader::SetTag>("Tag", "Whatever the program keeps with the header."),
    frame::property<&ColumnHeader::Index>("Index", "The number of the column, from 1."),
    frame::property<&ColumnHeader::SubItemIndex>("SubItemIndex", "The sub-item that the column shows; 0 for the text."),
    frame::property<&ColumnHeader::Position, &ColumnHeader::SetPosition>("Position", "Where the column stands in view, from 1."),
    frame::property<&ColumnHeader::Left>("Left", "The left edge in twips, in a list that is not scrolled."),
};
constexpr frame::ClassTable headerTable{.name = "ColumnHeader", .members = headerMembers, .defaultMember = "Text"};

constexpr std::array headersMembers = {
    frame::property<&ColumnHeaders::Count>("Count", "The number of columns."),
    frame::property<&ColumnHeaders::Item>("Item", "A header by its index, from 1, or its key."),
    frame::method<&ColumnHeaders::Add>("Add", "Adds a column and gives its header.",
                                       {"Index", "Key", "Text", "Width", "Alignment", "Icon"}),
    frame::method<&ColumnHeaders::Remove>("Remove", "Removes a column by its index or key.", {"Index"}),
    frame::method<&ColumnHeaders::Clear>("Clear", "Removes all columns."),
};
constexpr frame::ClassTable headersTable{.name = "ColumnHeaders", .members = headersMembers, .defaultMember = "Item"};

}  // namespace

const frame::ClassTable& ColumnHeader::Table() const { return headerTable; }
const frame::ClassTable& ColumnHeaders::Table() const { return headersTable; }

}  // namespace tessel::child
