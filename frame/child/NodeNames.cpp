#include "frame/child/NodeNames.h"

#include <utility>

#include "frame/Text.h"
#include "frame/child/RowIndex.h"

namespace tessel::child {

void NodeNames::Begin(NodeId node, std::string_view text, std::string_view key) {
    places_.MakeRoom(node);
    Put(node, text, key);
}

void NodeNames::End(NodeId node) {
    Drop(std::exchange(places_[node].place, NameStore::none));
    Tidy();
}

void NodeNames::Clear() { *this = NodeNames(); }

void NodeNames::Set(NodeId node, std::string_view text, std::string_view key) {
    const NameStore::Place before = places_[node].place;
    Put(node, text, key);
    Drop(before);
    Tidy();
}

std::optional<NodeId> NodeNames::FindKey(std::string_view key) const {
    if (key.empty()) return std::nullopt;
    NodeId node = noNode;
    const NameStore::Place found = keys_.Find(HashIndex::HashOf(key), [&](NameStore::Place place) {
        const NameStore::Name name = names_.Read(place);
        node = name.row;
        return name.key == key || frame::EqualsNoCase(name.key, key);
    });
    return found != KeyIndex::none ? std::optional(node) : std::nullopt;
}

void NodeNames::Put(NodeId node, std::string_view text, std::string_view key) {
    const NameStore::Place place = names_.Add(node, text, key);
    places_[node].place = place;
    const std::string_view kept = names_.Read(place).key;
    if (!kept.empty()) keys_.Add(place, HashIndex::HashOf(kept));
}

void NodeNames::Drop(NameStore::Place place) {
    const std::string_view key = names_.Read(place).key;
    if (!key.empty()) keys_.Remove(place, HashIndex::HashOf(key));
    droppedBytes_ += names_.SizeOf(place);
}

/// The names are gathered anew when what was dropped outweighs them and the way along all places: so it costs little each time.
void NodeNames::Tidy() {
    if (droppedBytes_ <= names_.Size() - droppedBytes_ + places_.Size()) return;
    const NameStore before = std::exchange(names_, NameStore());
    keys_.Clear();
    droppedBytes_ = 0;
    for (NodeId node = 0; node < places_.Size(); ++node) {
        if (places_[node].place == NameStore::none) continue;
        const NameStore::Name name = before.Read(places_[node].place);
        Put(node, name.text, name.key);
    }
}

}  // namespace tessel::child
