#include "frame/child/NodeNames.h"

#include <algorithm>
#include <utility>

#include "frame/Text.h"
#include "frame/child/RowIndex.h"

namespace tessel::child {

void NodeNames::Begin(NodeId node, std::string_view text, std::string_view key) {
    blocks_.MakeRoom(node);
    Write(node, text, key);
    Index(node, key);
}

void NodeNames::End(NodeId node) {
    Unindex(node);
    blocks_[node].reset();
}

void NodeNames::Clear() {
    blocks_.Clear();
    keys_.Clear();
}

void NodeNames::SetKey(NodeId node, std::string_view key) {
    Unindex(node);
    Write(node, Text(node), key);
    Index(node, Key(node));  // `key` may have stood in the old block
}

std::optional<NodeId> NodeNames::FindKey(std::string_view key) const {
    if (key.empty()) return std::nullopt;
    const NodeId found = keys_.Find(HashIndex::HashOf(key), [&](NodeId node) {
        const std::string_view candidate = Key(node);
        return candidate == key || frame::EqualsNoCase(candidate, key);
    });
    return found != KeyIndex::none ? std::optional(found) : std::nullopt;
}

void NodeNames::Index(NodeId node, std::string_view key) {
    if (!key.empty()) keys_.Add(node, HashIndex::HashOf(key));
}

void NodeNames::Unindex(NodeId node) {
    if (const std::string_view key = Key(node); !key.empty()) keys_.Remove(node, HashIndex::HashOf(key));
}

void NodeNames::Write(NodeId node, std::string_view text, std::string_view key) {
    const auto textSize = static_cast<std::uint32_t>(text.size()), keySize = static_cast<std::uint32_t>(key.size());
    // Made before the old block goes, which may hold one of the two.
    std::unique_ptr<char[]> block(new char[sizesBytes + text.size() + key.size()]);
    std::memcpy(block.get(), &textSize, sizeof textSize);
    std::memcpy(block.get() + sizeof textSize, &keySize, sizeof keySize);
    std::copy(key.begin(), key.end(), std::copy(text.begin(), text.end(), block.get() + sizesBytes));
    blocks_[node] = std::move(block);
}

}  // namespace tessel::child
