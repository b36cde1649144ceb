#pragma once

#include <cstddef>
#include <optional>
#include <string_view>

#include "frame/child/KeyIndex.h"
#include "frame/child/NameStore.h"
#include "frame/child/NodeShape.h"

namespace tessel::child {

/// The texts and keys of the nodes of a tree, and who has a key. Without regard to case a key is unique; that is its user's care.
/// 14 to 24 bytes a node besides what the store of names takes. A search for a key looks at two places in memory: the index and the
/// name.
class NodeNames {
  public:
    /// A new node; the empty key is none.
    void Begin(NodeId node, std::string_view text, std::string_view key);
    void End(NodeId node);
    void Clear();

    /// Good until any text or key is set, or a node ends.
    std::string_view Text(NodeId node) const { return names_.Read(places_[node].place).text; }
    std::string_view Key(NodeId node) const { return names_.Read(places_[node].place).key; }
    /// What is set may be a text or key of these nodes.
    void SetText(NodeId node, std::string_view text) { Set(node, text, Key(node)); }
    void SetKey(NodeId node, std::string_view key) { Set(node, Text(node), key); }
    std::optional<NodeId> FindKey(std::string_view key) const;

  private:
    struct PlaceOfName {
        NameStore::Place place = NameStore::none;
    };

    void Set(NodeId node, std::string_view text, std::string_view key);
    void Put(NodeId node, std::string_view text, std::string_view key);
    void Drop(NameStore::Place place);
    void Tidy();

    RowPages<PlaceOfName> places_;
    NameStore names_;
    KeyIndex keys_;  // by the places of the names
    std::size_t droppedBytes_ = 0;
};

}  // namespace tessel::child
