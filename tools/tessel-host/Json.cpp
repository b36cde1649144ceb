#include "tools/tessel-host/Json.h"

#include <charconv>
#include <cmath>
#include <limits>

#include "frame/ClassTable.h"
#include "frame/Dates.h"
#include "frame/Error.h"
#include "frame/Font.h"
#include "frame/Picture.h"
#include "frame/Text.h"

namespace tessel::tools {

using frame::ControlError;
using frame::Variant;
using frame::VarType;

namespace {

constexpr int deepest = 32;

/// A 32-bit float as the shortest number that reads back as it: 0.1, not 0.10000000149011612.
double ShortestDouble(float value) {
    if (!std::isfinite(value)) return value;
    char digits[32];
    const auto written = std::to_chars(std::begin(digits), std::end(digits), value);
    double result = value;
    std::from_chars(digits, written.ptr, result);
    return result;
}

Json FontToJson(frame::Font& font) {
    Json json = Json::object();
    for (const frame::Member& member : font.Table().members) json[std::string(member.name)] = ToJson(member.get(font, {}));
    return json;
}

Json ObjectToJson(const frame::ObjectRef& object) {
    frame::Object* target = object.Get();
    if (!target) return nullptr;
    if (auto* font = dynamic_cast<frame::Font*>(target)) return FontToJson(*font);
    if (const auto* picture = dynamic_cast<const frame::Picture*>(target))
        return {{"picture", frame::ToStrictUtf8(picture->Source())}};
    return {{"object", frame::ToStrictUtf8(target->Path())}};
}

Variant NumberFrom(const Json& json) {
    if (json.is_number_float()) return json.get<double>();
    if (json.is_number_unsigned() && json.get<std::uint64_t>() > std::numeric_limits<std::int32_t>::max())
        return static_cast<double>(json.get<std::uint64_t>());
    const auto number = json.get<std::int64_t>();
    if (number >= std::numeric_limits<std::int16_t>::min() && number <= std::numeric_limits<std::int16_t>::max())
        return static_cast<std::int16_t>(number);
    return Variant::FromCount(number);
}

Variant ValueFrom(const Json& json, const ObjectFinder& finder, int depth);

bool IsFont(const Json& json) {
    const frame::Font sample;
    if (json.empty()) return false;
    for (const auto& entry : json.items())  // NOLINT(readability-use-anyofallof): what items() gives is no range
        if (!sample.Table().Find(std::string_view(entry.key()))) return false;
    return true;
}

Variant ObjectFrom(const Json& json, const ObjectFinder& finder, int depth) {
    if (json.size() == 1) {
        const std::string& key = json.begin().key();
        const Json& value = json.begin().value();
        if (key == "missing") return Variant::Missing();
        const auto* find = key == "object"    ? &finder.byPath
                           : key == "picture" ? &finder.picture
                           : key == "drive"   ? &finder.drive
                           : key == "folder"  ? &finder.folder
                                              : nullptr;
        if (find && value.is_string()) return (*find)(frame::FromStrictUtf8(value.get<std::string>()));
    }
    if (!IsFont(json)) throw ControlError(frame::errors::typeMismatch);
    const auto font = std::make_shared<frame::Font>();
    for (const auto& entry : json.items()) font->Put(entry.key(), ValueFrom(entry.value(), finder, depth + 1));
    return font;
}

Variant ValueFrom(const Json& json, const ObjectFinder& finder, int depth) {
    if (depth > deepest) throw ControlError(frame::errors::invalidCall, "The value is nested too deep");
    switch (json.type()) {
        case Json::value_t::boolean:
            return json.get<bool>();
        case Json::value_t::string:
            return frame::FromStrictUtf8(json.get_ref<const std::string&>());
        case Json::value_t::number_integer:
        case Json::value_t::number_unsigned:
        case Json::value_t::number_float:
            return NumberFrom(json);
        case Json::value_t::object:
            return ObjectFrom(json, finder, depth);
        case Json::value_t::array: {
            std::vector<Variant> items;
            items.reserve(json.size());
            for (const Json& item : json) items.push_back(ValueFrom(item, finder, depth + 1));
            return frame::VariantArray(0, std::move(items));
        }
        default:
            return {};
    }
}

}  // namespace

Json ToJson(const Variant& value) {
    switch (value.Type()) {
        case VarType::Empty:
            return nullptr;
        case VarType::Missing:
            return {{"missing", true}};
        case VarType::Boolean:
            return value.ToBoolean();
        case VarType::Integer:
            return value.ToInteger();
        case VarType::Long:
            return value.IsColor() ? Json(value.ToColor().value) : Json(value.ToLong());
        case VarType::Single:
            return ShortestDouble(value.ToSingle());
        case VarType::Double:
            return value.ToDouble();
        case VarType::String:
            return frame::ToStrictUtf8(value.Text());
        case VarType::Date:
            return frame::DateText(value.ToDate());
        case VarType::Object:
            return ObjectToJson(value.ToObject());
        case VarType::Array: {
            Json array = Json::array();
            for (const Variant& item : value.ToArray().items) array.push_back(ToJson(item));
            return array;
        }
    }
    return nullptr;
}

Variant FromJson(const Json& json, const ObjectFinder& finder) { return ValueFrom(json, finder, 0); }

}  // namespace tessel::tools
