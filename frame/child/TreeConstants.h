#pragma once

#include <cstdint>

#include "frame/Member.h"

/// The enumerations of the tree view.
namespace tessel::child {

/// Where a new node stands: first or last among the siblings of another, right behind or before it, or as its last child.
enum class TreeRelationshipConstants : std::int16_t { First = 0, Last = 1, Next = 2, Previous = 3, Child = 4 };
/// What is shown of each node. Those with "PlusMinus" have a sign before each node that has children.
enum class TreeStyleConstants : std::int16_t {
    TextOnly = 0,
    PictureText = 1,
    PlusMinusText = 2,
    PlusPictureText = 3,
    TreelinesText = 4,
    TreelinesPictureText = 5,
    TreelinesPlusMinusText = 6,
    TreelinesPlusMinusPictureText = 7
};
/// Whether the nodes of the top level have lines and signs too.
enum class TreeLineStyleConstants : std::int16_t { TreeLines = 0, RootLines = 1 };
/// With `Automatic` a click on the label of the selected node opens its edit.
enum class TreeLabelEditConstants : std::int16_t { Automatic = 0, Manual = 1 };
enum class TreeBorderConstants : std::int16_t { None = 0, FixedSingle = 1 };

namespace names {
inline constexpr frame::Enumeration::Constant treeRelationship[] = {
    {"First", 0}, {"Last", 1}, {"Next", 2}, {"Previous", 3}, {"Child", 4}};
inline constexpr frame::Enumeration::Constant treeStyle[] = {
    {"TextOnly", 0},      {"PictureText", 1},          {"PlusMinusText", 2},          {"PlusPictureText", 3},
    {"TreelinesText", 4}, {"TreelinesPictureText", 5}, {"TreelinesPlusMinusText", 6}, {"TreelinesPlusMinusPictureText", 7}};
inline constexpr frame::Enumeration::Constant treeLineStyle[] = {{"TreeLines", 0}, {"RootLines", 1}};
inline constexpr frame::Enumeration::Constant treeLabelEdit[] = {{"Automatic", 0}, {"Manual", 1}};
inline constexpr frame::Enumeration::Constant treeBorder[] = {{"None", 0}, {"FixedSingle", 1}};
}  // namespace names
inline constexpr frame::Enumeration treeRelationshipConstants{"TreeRelationshipConstants", names::treeRelationship};
inline constexpr frame::Enumeration treeStyleConstants{"TreeStyleConstants", names::treeStyle};
inline constexpr frame::Enumeration treeLineStyleConstants{"TreeLineStyleConstants", names::treeLineStyle};
inline constexpr frame::Enumeration treeLabelEditConstants{"TreeLabelEditConstants", names::treeLabelEdit};
inline constexpr frame::Enumeration treeBorderConstants{"TreeBorderConstants", names::treeBorder};

}  // namespace tessel::child

namespace tessel::frame {
template <>
inline constexpr const Enumeration* enumerationOf<child::TreeRelationshipConstants> = &child::treeRelationshipConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::TreeStyleConstants> = &child::treeStyleConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::TreeLineStyleConstants> = &child::treeLineStyleConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::TreeLabelEditConstants> = &child::treeLabelEditConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::TreeBorderConstants> = &child::treeBorderConstants;
}  // namespace tessel::frame
