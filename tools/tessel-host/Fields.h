#pragma once

#include <string>

#include "frame/Error.h"
#include "frame/Text.h"
#include "tools/tessel-host/Json.h"

/// Reading the fields of a request. Error 5 for one that lacks or has another kind.
namespace tessel::tools {

[[noreturn]] inline void Refuse(const std::string& why) { throw frame::ControlError(frame::errors::invalidCall, why); }

inline const Json* FieldOf(const Json& request, const char* name) {
    const auto found = request.find(name);
    return found != request.end() ? &*found : nullptr;
}

inline const Json& Required(const Json& request, const char* name) {
    const Json* field = FieldOf(request, name);
    if (!field) Refuse(std::string("The request lacks its field \"") + name + "\"");
    return *field;
}

inline std::string TextOf(const Json& json, const char* name) {
    if (!json.is_string()) Refuse(std::string("\"") + name + "\" must be a string");
    return frame::FromStrictUtf8(json.get_ref<const std::string&>());
}

inline std::string RequiredText(const Json& request, const char* name) { return TextOf(Required(request, name), name); }

/// The name of something new.
inline std::string NameIn(const Json& request) {
    std::string name = RequiredText(request, "name");
    if (name.empty()) Refuse("\"name\" must not be empty");
    return name;
}

inline const Json& ListIn(const Json& request, const char* name) {
    static const Json none = Json::array();
    const Json* field = FieldOf(request, name);
    if (!field) return none;
    if (!field->is_array()) Refuse(std::string("\"") + name + "\" must be a list");
    return *field;
}

inline const Json& ObjectIn(const Json& json, const char* name) {
    if (!json.is_object()) Refuse(std::string("\"") + name + "\" must be an object");
    return json;
}

inline bool FlagIn(const Json& request, const char* name, bool otherwise) {
    const Json* field = FieldOf(request, name);
    if (!field) return otherwise;
    if (!field->is_boolean()) Refuse(std::string("\"") + name + "\" must be true or false");
    return field->get<bool>();
}

}  // namespace tessel::tools
