#pragma once

#include <functional>
#include <string>

#include <nlohmann/json.hpp>

#include "frame/Variant.h"

namespace tessel::tools {

using Json = nlohmann::ordered_json;

/// A value as JSON: numbers, strings and booleans are themselves, Empty and no object are null, colours are positive numbers,
/// fonts are objects of their members, pictures `{"picture":file}`, other objects `{"object":path}`, arrays are arrays from
/// their first element on. Texts that are no valid UTF-8 go through `frame::ToStrictUtf8`.
Json ToJson(const frame::Variant& value);

/// What `FromJson` asks about objects.
struct ObjectFinder {
    std::function<frame::ObjectRef(const std::string& path)> byPath = {};
    std::function<frame::ObjectRef(const std::string& file)> picture = {};
    std::function<frame::ObjectRef(const std::string& name)> drive = {};
    std::function<frame::ObjectRef(const std::string& path)> folder = {};
};

/// The value of a piece of JSON. Whole numbers take the least of 16 bits, 32 bits and a float that holds them.
/// Error 13 for an object of unknown form, 5 for one that is nested too deep.
frame::Variant FromJson(const Json& json, const ObjectFinder& finder);

}  // namespace tessel::tools
