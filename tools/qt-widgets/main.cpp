#include <fstream>
#include <iostream>
#include <map>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "controls/Classes.h"
#include "frame/ClassTable.h"
#include "frame/Text.h"

/// Writes a control class as a widget class: its members as Qt properties and slots, its events as signals, its enumerations.
namespace {

using namespace tessel::frame;

/// "LinkTo" as Qt names properties: "linkTo".
bool IsCapital(char letter) { return letter >= 'A' && letter <= 'Z'; }

/// The first word begins small; one that is an abbreviation is small as a whole: `backColor`, `oleDragMode`.
std::string Lower(std::string_view name) {
    std::string result(name);
    for (std::size_t i = 0; i < name.size() && IsCapital(name[i]); ++i) {
        const bool startsNextWord = i > 0 && i + 1 < name.size() && !IsCapital(name[i + 1]);
        if (startsNextWord) break;
        result[i] = static_cast<char>(name[i] - 'A' + 'a');
    }
    return result;
}

std::string Upper(std::string_view name) {
    std::string result(name);
    if (!result.empty() && result[0] >= 'a' && result[0] <= 'z') result[0] = static_cast<char>(result[0] - 'a' + 'A');
    return result;
}

/// How a value is given in C++ to those who use Qt.
struct QtType {
    std::string name;
    std::string parameter;    ///< as a function takes it
    std::string fromVariant;  ///< what is called on a `QVariant`; the whole expression where it holds a %
};

QtType TypeOf(const TypeInfo& type) {
    if (type.enumeration) {
        const std::string name(type.enumeration->name);
        return {name, name, "static_cast<" + name + ">(%.toInt())"};
    }
    if (type.isColor) return {"QColor", "const QColor&", "%.value<QColor>()"};
    switch (type.type) {
        case VarType::Boolean:
            return {"bool", "bool", "%.toBool()"};
        case VarType::Integer:
        case VarType::Long:
            return {"int", "int", "%.toInt()"};
        case VarType::Single:
        case VarType::Double:
            return {"double", "double", "%.toDouble()"};
        case VarType::String:
        case VarType::Date:
            return {"QString", "const QString&", "%.toString()"};
        default:
            return {"QVariant", "const QVariant&", "%"};
    }
}

/// Objects are told apart by the name of the member or parameter: the table knows no more than that it is one.
QtType TypeOf(const Member& member) {
    if (member.type.type == VarType::Object && member.name == "Font") return {"QFont", "const QFont&", "%.value<QFont>()"};
    if (member.type.type == VarType::Object) return {"QImage", "const QImage&", "%.value<QImage>()"};
    return TypeOf(member.type);
}

/// The storage behind an argument of an event.
std::string StorageOf(const Parameter& parameter) {
    switch (parameter.type.type) {
        case VarType::Boolean:
            return "bool";
        case VarType::Integer:
            return "short";
        case VarType::Long:
            return "int";
        case VarType::Single:
            return "float";
        case VarType::Double:
            return "double";
        case VarType::String:
            return "std::string";
        case VarType::Object:
            return parameter.name == "Node" ? "tessel::child::TreeNodeRef" : "tessel::child::DragDataRef";
        default:
            return "tessel::frame::Variant";
    }
}

std::string Filled(std::string text, const std::string& value) {
    const std::size_t place = text.find('%');
    return text.replace(place, 1, value);
}

std::string SignalParameters(const EventInfo& event) {
    std::string text;
    for (const Parameter& parameter : event.parameters.All())
        text += (text.empty() ? "" : ", ") + StorageOf(parameter) + "& " + Lower(parameter.name);
    return text;
}

/// Whether Qt's own property of a widget stands for the member.
bool IsOfEveryWidget(const Member& member) { return member.name == "Enabled"; }

class Writer {
  public:
    /// `beside` names functions of the base that stand beside members of the same name.
    Writer(const ClassTable& table, std::vector<std::string> beside)
        : table_(table), name_(table.name), beside_(std::move(beside)) {
        for (const Member& member : table.members) {
            if (member.isMethod)
                methods_.push_back(&member);
            else if (member.parameters.count == 0)
                properties_.push_back(&member);
        }
    }

    void WriteHeader(std::ostream& file, const std::string& base) const {
        file << "#pragma once\n\n#include <QColor>\n#include <QFont>\n#include <QImage>\n#include <QString>\n#include <QVariant>\n"
             << "#include <string>\n\n#include \"controls/" << Folder() << "/" << name_ << ".h\"\n#include \"hosts/qt/" << base
             << ".h\"\n\nnamespace tessel::qt {\n\n"
             << "/// The control `" << name_ << "` as a widget. Made from its class table; docs/reference/" << name_
             << ".md has its members.\n///\n/// Each property is there by its name in the library's spelling too, for "
                "`QObject::property`.\n"
             << "class " << name_ << " : public " << base << " {\n    Q_OBJECT\n";
        for (const Member* member : properties_) WriteProperty(file, *member);
        file << "\n  public:\n    explicit " << name_ << "(QWidget* parent = nullptr);\n"
             << "    /// The control itself: its members as C++ functions, with exceptions for errors.\n"
             << "    controls::" << name_ << "& control() const { return static_cast<controls::" << name_
             << "&>(ControlWidget::control()); }\n\n";
        for (const std::string& function : beside_) file << "    using " << base << "::" << function << ";\n\n";
        WriteEnumerations(file);
        for (const Member* member : properties_) {
            if (IsOfEveryWidget(*member)) continue;
            const QtType type = TypeOf(*member);
            file << "    /// " << member->help << "\n    " << type.name << " " << Lower(member->name) << "() const;\n";
            if (member->set) file << "    void set" << Upper(member->name) << "(" << type.parameter << " value);\n";
        }
        if (!methods_.empty()) file << "\n  public slots:\n";
        for (const Member* member : methods_)
            file << "    /// " << member->help << "\n    " << ResultOf(*member) << " " << Lower(member->name) << "("
                 << MethodParameters(*member, Defaults::Given) << ");\n";
        file << "\n  signals:\n";
        for (const EventInfo* event : table_.events)
            file << "    /// " << event->help << "\n    void " << Lower(event->name) << "(" << SignalParameters(*event) << ");\n";
        for (const Member* member : properties_)
            if (Notifies(*member)) file << "    void " << Lower(member->name) << "Changed();\n";
        file << "\n  protected:\n    bool hears(const frame::EventInfo& event) const override;\n"
             << "    void raise(const frame::EventInfo& event, frame::EventArguments arguments) override;\n"
             << "    void propertyChanged(std::string_view key) override;\n};\n\n}  // namespace tessel::qt\n";
    }

    void WriteSource(std::ostream& file, const std::string& base) const {
        file << "#include \"hosts/qt/" << name_
             << ".h\"\n\n#include <QMetaMethod>\n#include <QPointer>\n\n#include \"controls/Classes.h\"\n"
             << "#include \"frame/Text.h\"\n\nnamespace tessel::qt {\n\n"
             << name_ << "::" << name_ << "(QWidget* parent) : " << base << "(*controls::FindControlClass(\"" << name_
             << "\"), parent) {}\n\n";
        for (const Member* member : properties_) {
            if (IsOfEveryWidget(*member)) continue;
            const QtType type = TypeOf(*member);
            const std::string value = Filled(type.fromVariant, "get(\"" + std::string(member->name) + "\")");
            file << (member->type.enumeration ? name_ + "::" : "") << type.name << " " << name_ << "::" << Lower(member->name)
                 << "() const { return " << value << "; }\n";
            if (member->set)
                file << "void " << name_ << "::set" << Upper(member->name) << "(" << type.parameter << " value) { put(\""
                     << member->name << "\", " << AsVariant("value", type) << "); }\n";
        }
        for (const Member* member : methods_) WriteMethod(file, *member);
        WriteEvents(file);
        WriteNotifications(file, base);
        file << "\n}  // namespace tessel::qt\n";
    }

  private:
    enum class Defaults { None, Given };

    std::string Folder() const {
        std::string folder;
        for (const char letter : name_) folder += static_cast<char>(letter >= 'A' && letter <= 'Z' ? letter - 'A' + 'a' : letter);
        return folder;
    }

    static bool Notifies(const Member& member) { return member.set && !IsOfEveryWidget(member); }

    void WriteProperty(std::ostream& file, const Member& member) const {
        if (IsOfEveryWidget(member)) {
            file << "    Q_PROPERTY(bool " << member.name
                 << " READ controlEnabled WRITE setControlEnabled DESIGNABLE false STORED false)\n";
            return;
        }
        const std::string lower = Lower(member.name);
        const std::string write = member.set ? " WRITE set" + Upper(member.name) : "";
        const std::string notify = Notifies(member) ? " NOTIFY " + lower + "Changed" : "";
        const std::string rest = " READ " + lower + write + notify;
        file << "    Q_PROPERTY(" << TypeOf(member).name << " " << lower << rest << " STORED false)\n";
        if (lower == member.name) return;
        file << "    Q_PROPERTY(" << TypeOf(member).name << " " << member.name << rest << " DESIGNABLE false STORED false)\n";
    }

    void WriteEnumerations(std::ostream& file) const {
        std::map<std::string_view, const Enumeration*> used;
        for (const Member* member : properties_)
            if (member->type.enumeration) used.emplace(member->type.enumeration->name, member->type.enumeration);
        std::map<std::string_view, int> uses;
        for (const auto& [name, enumeration] : used)
            for (const Enumeration::Constant& constant : enumeration->constants) ++uses[constant.name];
        for (const auto& [name, enumeration] : used) {
            // A designer wants the constants in the class itself: one that two enumerations have tells whose it is.
            const std::string prefix(name.substr(0, name.rfind("Constants")));
            file << "    enum " << name << " : int {";
            const char* separator = " ";
            for (const Enumeration::Constant& constant : enumeration->constants) {
                file << separator << (uses[constant.name] > 1 ? prefix : "") << constant.name << " = " << constant.value;
                separator = ", ";
            }
            file << " };\n    Q_ENUM(" << name << ")\n";
        }
        if (!used.empty()) file << '\n';
    }

    static std::string ResultOf(const Member& member) {
        return member.type.type == VarType::Empty && !member.type.isColor ? "void" : TypeOf(member).name;
    }

    static std::string MethodParameters(const Member& member, Defaults defaults) {
        std::string text;
        for (const Parameter& parameter : member.parameters.All()) {
            const std::string type = parameter.optional ? "const QVariant&" : TypeOf(parameter.type).parameter;
            text += (text.empty() ? "" : ", ") + type + " " + Lower(parameter.name);
            if (parameter.optional && defaults == Defaults::Given) text += " = {}";
        }
        return text;
    }

    static std::string AsVariant(const std::string& value, const QtType& type) {
        if (type.name == "QVariant") return value;
        if (type.name == "QFont" || type.name == "QImage" || type.name == "QColor") return "QVariant::fromValue(" + value + ")";
        return type.fromVariant.starts_with("static_cast") ? "static_cast<int>(" + value + ")" : "QVariant(" + value + ")";
    }

    void WriteMethod(std::ostream& file, const Member& member) const {
        const std::string result = ResultOf(member);
        file << result << " " << name_ << "::" << Lower(member.name) << "(" << MethodParameters(member, Defaults::None) << ") { ";
        std::string call = "call(\"" + std::string(member.name) + "\", {";
        const char* separator = "";
        for (const Parameter& parameter : member.parameters.All()) {
            call +=
                separator + (parameter.optional ? Lower(parameter.name) : AsVariant(Lower(parameter.name), TypeOf(parameter.type)));
            separator = ", ";
        }
        call += "})";
        file << (result == "void" ? call : "return " + Filled(TypeOf(member).fromVariant, call)) << "; }\n";
    }

    void WriteEvents(std::ostream& file) const {
        file << "\nbool " << name_ << "::hears(const frame::EventInfo& event) const {\n    switch (event.number) {\n";
        for (const EventInfo* event : table_.events)
            file << "        case " << event->number
                 << ": {\n            static const QMetaMethod signal = QMetaMethod::fromSignal(&" << name_
                 << "::" << Lower(event->name) << ");\n            return isSignalConnected(signal);\n        }\n";
        file << "        default: return false;\n    }\n}\n\nvoid " << name_
             << "::raise(const frame::EventInfo& event, frame::EventArguments" << (HasArguments() ? " arguments" : "")
             << ") {\n    switch (event.number) {\n";
        for (const EventInfo* event : table_.events) {
            file << "        case " << event->number << ": emit " << Lower(event->name) << "(";
            for (std::size_t i = 0; i < event->parameters.count; ++i)
                file << (i ? ", " : "") << "arguments[" << i << "].As<" << StorageOf(event->parameters.list[i]) << ">()";
            file << "); break;\n";
        }
        file << "        default: break;\n    }\n}\n";
    }

    bool HasArguments() const {
        for (const EventInfo* event : table_.events)
            if (event->parameters.count) return true;
        return false;
    }

    void WriteNotifications(std::ostream& file, const std::string& base) const {
        file << "\n// Keys of saved state may be spelled otherwise than the property.\nvoid " << name_
             << "::propertyChanged(std::string_view key) {\n    const QPointer<" << name_ << "> alive = this;\n    " << base
             << "::propertyChanged(key);\n    if (!alive) return;\n";
        for (const Member* member : properties_)
            if (Notifies(*member))
                file << "    if (frame::EqualsNoCase(key, \"" << member->name << "\")) return emit " << Lower(member->name)
                     << "Changed();\n";
        file << "}\n";
    }

    const ClassTable& table_;
    std::string name_;
    std::vector<std::string> beside_;
    std::vector<const Member*> properties_, methods_;
};

/// Writes a file only where it reads otherwise, so that nothing is compiled for nothing.
bool Write(const std::string& name, const std::string& text) {
    std::ifstream present(name, std::ios::binary);
    std::stringstream old;
    old << present.rdbuf();
    if (present && old.str() == text) return true;
    std::ofstream file(name, std::ios::binary);
    file << text;
    return static_cast<bool>(file.flush());
}

}  // namespace

/// tessel-qt-widgets class base folder [function...]: writes <class>.h and <class>.cpp, a widget that derives from `base`.
int main(int count, char** arguments) {
    if (count < 4) {
        std::cerr << "usage: tessel-qt-widgets class base folder [function...]\n";
        return 2;
    }
    const ControlClass* controlClass = tessel::controls::FindControlClass(arguments[1]);
    if (!controlClass) {
        std::cerr << "tessel-qt-widgets: no class " << arguments[1] << '\n';
        return 2;
    }
    const Writer writer(*controlClass->table, {arguments + 4, arguments + count});
    std::ostringstream header, source;
    writer.WriteHeader(header, arguments[2]);
    writer.WriteSource(source, arguments[2]);
    const std::string path = std::string(arguments[3]) + "/" + std::string(controlClass->table->name);
    if (Write(path + ".h", header.str()) && Write(path + ".cpp", source.str())) return 0;
    std::cerr << "tessel-qt-widgets: cannot write " << path << '\n';
    return 1;
}
