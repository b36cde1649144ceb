#pragma once

#include <cstdint>

#include "frame/Member.h"

/// The enumerations of the list view.
namespace tessel::child {

enum class ListViewConstants : std::int16_t { Icon = 0, SmallIcon = 1, List = 2, Report = 3 };
enum class ListSortOrderConstants : std::int16_t { Ascending = 0, Descending = 1 };
enum class ListArrangeConstants : std::int16_t { None = 0, Left = 1, Top = 2 };
/// With `Automatic` a click on the label of a row that is already selected opens its edit.
enum class ListLabelEditConstants : std::int16_t { Automatic = 0, Manual = 1 };
enum class ListPictureAlignmentConstants : std::int16_t {
    TopLeft = 0,
    TopRight = 1,
    BottomLeft = 2,
    BottomRight = 3,
    Center = 4,
    Tile = 5
};
enum class ListBorderConstants : std::int16_t { None = 0, FixedSingle = 1 };
enum class ListFindWhereConstants : std::int16_t { Text = 0, SubItem = 1, Tag = 2 };
enum class ListFindHowConstants : std::int16_t { Whole = 0, Partial = 1 };
/// How the user selects a row: it alone; it the other way round; all from the row where the last such selection began, alone or
/// beside what is selected.
enum class ListSelectConstants : std::int16_t { Only = 0, Toggle = 1, Range = 2, AddRange = 3 };

namespace names {
inline constexpr frame::Enumeration::Constant listView[] = {{"Icon", 0}, {"SmallIcon", 1}, {"List", 2}, {"Report", 3}};
inline constexpr frame::Enumeration::Constant listSortOrder[] = {{"Ascending", 0}, {"Descending", 1}};
inline constexpr frame::Enumeration::Constant listArrange[] = {{"None", 0}, {"Left", 1}, {"Top", 2}};
inline constexpr frame::Enumeration::Constant listLabelEdit[] = {{"Automatic", 0}, {"Manual", 1}};
inline constexpr frame::Enumeration::Constant listPictureAlignment[] = {{"TopLeft", 0},     {"TopRight", 1}, {"BottomLeft", 2},
                                                                        {"BottomRight", 3}, {"Center", 4},   {"Tile", 5}};
inline constexpr frame::Enumeration::Constant listBorder[] = {{"None", 0}, {"FixedSingle", 1}};
inline constexpr frame::Enumeration::Constant listFindWhere[] = {{"Text", 0}, {"SubItem", 1}, {"Tag", 2}};
inline constexpr frame::Enumeration::Constant listFindHow[] = {{"Whole", 0}, {"Partial", 1}};
inline constexpr frame::Enumeration::Constant listSelect[] = {{"Only", 0}, {"Toggle", 1}, {"Range", 2}, {"AddRange", 3}};
}  // namespace names
inline constexpr frame::Enumeration listViewConstants{"ListViewConstants", names::listView};
inline constexpr frame::Enumeration listSortOrderConstants{"ListSortOrderConstants", names::listSortOrder};
inline constexpr frame::Enumeration listArrangeConstants{"ListArrangeConstants", names::listArrange};
inline constexpr frame::Enumeration listLabelEditConstants{"ListLabelEditConstants", names::listLabelEdit};
inline constexpr frame::Enumeration listPictureAlignmentConstants{"ListPictureAlignmentConstants", names::listPictureAlignment};
inline constexpr frame::Enumeration listBorderConstants{"ListBorderConstants", names::listBorder};
inline constexpr frame::Enumeration listFindWhereConstants{"ListFindWhereConstants", names::listFindWhere};
inline constexpr frame::Enumeration listFindHowConstants{"ListFindHowConstants", names::listFindHow};
inline constexpr frame::Enumeration listSelectConstants{"ListSelectConstants", names::listSelect};

}  // namespace tessel::child

namespace tessel::frame {
template <>
inline constexpr const Enumeration* enumerationOf<child::ListViewConstants> = &child::listViewConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::ListSortOrderConstants> = &child::listSortOrderConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::ListArrangeConstants> = &child::listArrangeConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::ListLabelEditConstants> = &child::listLabelEditConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::ListPictureAlignmentConstants> = &child::listPictureAlignmentConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::ListBorderConstants> = &child::listBorderConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::ListFindWhereConstants> = &child::listFindWhereConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::ListFindHowConstants> = &child::listFindHowConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::ListSelectConstants> = &child::listSelectConstants;
}  // namespace tessel::frame
