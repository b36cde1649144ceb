#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <optional>
#include <string_view>

#include "frame/child/KeyIndex.h"
#include "frame/child/NodeShape.h"

namespace tessel::child {

/// The texts and keys of the nodes of a tree, those of a node in one block, and who has a key. Without regard to case a key is
/// unique; that is its user's care. 26 to 36 bytes a node besides the block's own characters, and what its allocation takes.
class NodeNames {
  public:
    /// A new node; the empty key is none.
    void Begin(NodeId node, std::string_view text, std::string_view key);
    void End(NodeId node);
    void Clear();

    /// Good until the node's text or key is set.
    std::string_view Text(NodeId node) const {
        const Name name = Read(node);
        return {name.characters, name.textSize};
    }
    std::string_view Key(NodeId node) const {
        const Name name = Read(node);
        return {name.characters + name.textSize, name.keySize};
    }
    void SetText(NodeId node, std::string_view text) { Write(node, text, Key(node)); }
    void SetKey(NodeId node, std::string_view key);
    std::optional<NodeId> FindKey(std::string_view key) const;

  private:
    /// What a block holds: the two sizes, the characters of the text and those of the key.
    struct Name {
        std::uint32_t textSize = 0, keySize = 0;
        const char* characters = nullptr;
    };
    static constexpr std::size_t sizesBytes = 2 * sizeof(std::uint32_t);

    Name Read(NodeId node) const {
        const char* block = blocks_[node].get();
        Name name;
        std::memcpy(&name.textSize, block, sizeof name.textSize);
        std::memcpy(&name.keySize, block + sizeof name.textSize, sizeof name.keySize);
        name.characters = block + sizesBytes;
        return name;
    }
    void Index(NodeId node, std::string_view key);
    void Unindex(NodeId node);
    void Write(NodeId node, std::string_view text, std::string_view key);

    RowPages<std::unique_ptr<char[]>> blocks_;
    KeyIndex keys_;
};

}  // namespace tessel::child
