#include <fstream>
#include <iostream>
#include <map>
#include <sstream>
#include <string>

#include "controls/Classes.h"
#include "frame/ClassTable.h"
#include "frame/Text.h"

namespace {

using namespace tessel::frame;

std::string TypeText(const TypeInfo& type) {
    if (type.enumeration) return "`" + std::string(type.enumeration->name) + "`";
    if (type.isColor) return "`OLE_COLOR`";
    return type.type == VarType::Empty ? "Variant" : std::string(VarTypeName(type.type));
}

std::string ParametersText(const Parameters& parameters) {
    std::string text;
    for (const Parameter& parameter : parameters.All()) {
        if (!text.empty()) text += ", ";
        text += std::string(parameter.optional ? "optional " : "") + "`" + std::string(parameter.name) + "` " +
                TypeText(parameter.type);
    }
    return text.empty() ? "none" : text;
}

std::string KindText(const Member& member) {
    if (member.isMethod) return "method";
    switch (member.access) {
        case Access::Plain: return "property";
        case Access::RunTime: return "property, set at run time only (else error 387)";
        case Access::ReadOnly: return "property, never set (error 387 or 382)";
        case Access::GetOnly: return "property, read only";
    }
    return {};
}

std::string DefaultText(const BagDefault& value) {
    switch (value.source) {
        case BagDefault::Source::AmbientFont: return "the ambient font";
        case BagDefault::Source::NoObject: return "no object";
        case BagDefault::Source::None: return "none";
        case BagDefault::Source::Value: break;
    }
    if (value.type == VarType::String) return "\"" + std::string(value.text) + "\"";
    if (value.type == VarType::Boolean) return value.number != 0 ? "true" : "false";
    if (!value.isColor) return Variant(value.number).ToText();
    std::ostringstream hexadecimal;
    hexadecimal << "0x" << std::hex << std::uppercase << static_cast<std::uint32_t>(static_cast<std::int64_t>(value.number));
    return hexadecimal.str();
}

void WriteMembers(std::ostream& page, const ClassTable& table) {
    page << "## Members\n\n| Member | Number | Kind | Type | Arguments | Meaning |\n|---|---|---|---|---|---|\n";
    for (const Member& member : table.members) {
        const bool returns = !member.isMethod || member.type.type != VarType::Empty;
        page << "| `" << member.name << "` | " << table.NumberOf(member) << " | " << KindText(member) << " | "
             << (returns ? TypeText(member.type) : "none") << " | "
             << (member.isMethod ? ParametersText(member.parameters) : "") << " | " << member.help << " |\n";
    }
}

void WriteEvents(std::ostream& page, const ClassTable& table) {
    page << "\n## Events\n\nAll arguments go by reference.\n\n| Event | Number | Arguments | Meaning |\n|---|---|---|---|\n";
    for (const EventInfo* event : table.events)
        page << "| `" << event->name << "` | " << event->number << " | " << ParametersText(event->parameters) << " | " << event->help
             << " |\n";
}

void WriteBag(std::ostream& page, const ClassTable& table) {
    page << "\n## Saved state\n\nThe keys of the property bag, in the order in which they are loaded. A value equal to its default "
            "is left out.\n\n| Key | Type | Default |\n|---|---|---|\n";
    for (const BagKey& key : table.bag) {
        page << "| `" << key.name << "` | " << VarTypeName(key.onLoad.type) << " | " << DefaultText(key.onLoad);
        if (DefaultText(key.onSave) != DefaultText(key.onLoad)) page << "; on save " << DefaultText(key.onSave);
        page << " |\n";
    }
    if (table.savedBehind.empty()) return;
    page << "\nBehind them a save writes, and a load does not read: ";
    const char* separator = "";
    for (const SavedKey& key : table.savedBehind) {
        page << separator << '`' << key.name << "` (default " << DefaultText(key.onSave) << ")";
        separator = ", ";
    }
    page << ".\n";
}

void WriteEnumerations(std::ostream& page, const ClassTable& table) {
    std::map<std::string_view, const Enumeration*> used;
    for (const Member& member : table.members)
        if (member.type.enumeration) used.emplace(member.type.enumeration->name, member.type.enumeration);
    if (used.empty()) return;
    page << "\n## Enumerations\n";
    for (const auto& [name, enumeration] : used) {
        page << "\n`" << name << "`:";
        const char* separator = " ";
        for (const Enumeration::Constant& constant : enumeration->constants) {
            page << separator << '`' << constant.name << "` = " << constant.value;
            separator = ", ";
        }
        page << ".\n";
    }
}

}  // namespace

/// tessel-reference folder: writes the reference page of each class of controls, `<class>.md`, from its table.
int main(int count, char** arguments) {
    if (count != 2) {
        std::cerr << "usage: tessel-reference folder\n";
        return 2;
    }
    for (const ControlClass& controlClass : tessel::controls::ControlClasses()) {
        const ClassTable& table = *controlClass.table;
        const std::string file = std::string(arguments[1]) + "/" + std::string(table.name) + ".md";
        std::ofstream page(file, std::ios::binary);
        page << "# " << table.name << "\n\nMade by `tessel-reference` from the class table; change it there.\n\n";
        WriteMembers(page, table);
        WriteEvents(page, table);
        WriteBag(page, table);
        WriteEnumerations(page, table);
        if (!page.flush()) {
            std::cerr << "tessel-reference: cannot write " << file << '\n';
            return 1;
        }
    }
    return 0;
}
