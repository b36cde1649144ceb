#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <initializer_list>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "controls/Classes.h"
#include "frame/ClassTable.h"
#include "frame/Control.h"
#include "frame/Text.h"
#include "tests/ErrorOf.h"
#include "tests/HostUnderTest.h"

/// What the tests of the drop-down list of pairs share. They reach the control and its children by name alone.
namespace tessel::controls::datalisttest {

using frame::Variant;

inline constexpr float width = 2100, height = 900;
inline constexpr std::int16_t textOnly = 0, idAndText = 1, countAndText = 2;

inline const frame::ControlClass& DataListClass() {
    const frame::ControlClass* found = FindControlClass("DataList");
    if (!found) throw frame::ControlError(frame::errors::noSuchElement, "There is no class DataList");
    return *found;
}
inline const frame::ClassTable& DataListTable() { return *DataListClass().table; }

/// A source of records in memory. It counts what is asked of it, and fails where a test wants it.
class Records final : public frame::Object {
  public:
    using Row = std::vector<Variant>;

    explicit Records(std::vector<Row> given) : rows(std::move(given)) {}

    /// Lets the call of that name fail that comes as the `nth`, from 1. The steps are MoveFirst, MoveNext, EOF, "Fields(Name)",
    /// "Name(Name)" and "Value(Name)" with the column's own name.
    void FailAt(const std::string& step, int nth, int number, const std::string& words) {
        failures_.insert_or_assign({step, nth}, frame::ControlError(number, words));
    }
    void FailAt(const std::string& step, int number, const std::string& words) { FailAt(step, 1, number, words); }
    int Times(const std::string& step) const {
        const auto found = times_.find(step);
        return found != times_.end() ? found->second : 0;
    }

    std::vector<std::string> columns = {"Name", "Id"};
    std::vector<Row> rows;
    std::size_t position = 0;
    bool refusesToBeEmpty = true;                         ///< MoveFirst fails where there are no rows
    std::vector<Variant> askedColumns;                    ///< what `Fields` was given
    std::vector<std::string> steps;                       ///< what was asked, in order
    std::function<void(const std::string& step)> onStep;  ///< what happens meanwhile

    static constexpr int noRecordNumber = 3021, noColumnNumber = 3265;
    static constexpr const char* noRecord = "No current record.";
    static constexpr const char* noColumn = "Item not found in this collection.";

    void MoveFirst() {
        Step("MoveFirst");
        if (rows.empty() && refusesToBeEmpty) throw frame::ControlError(noRecordNumber, noRecord);
        position = 0;
    }
    void MoveNext() {
        Step("MoveNext");
        if (position >= rows.size()) throw frame::ControlError(noRecordNumber, noRecord);
        ++position;
    }
    bool AtEnd() {
        Step("EOF");
        return position >= rows.size();
    }

    class Field final : public frame::Object {
      public:
        Field(Records& records, std::size_t column) : records_(records), column_(column) {}
        std::string Name() {
            records_.Step("Name(" + records_.columns[column_] + ")");
            return records_.columns[column_];
        }
        /// That of the record at which the source stands when it is read.
        Variant Value() {
            records_.Step("Value(" + records_.columns[column_] + ")");
            if (records_.position >= records_.rows.size()) throw frame::ControlError(noRecordNumber, noRecord);
            return records_.rows[records_.position].at(column_);
        }
        const frame::ClassTable& Table() const override {
            static constexpr std::array members = {frame::property<&Field::Name>("Name"), frame::property<&Field::Value>("Value")};
            static constexpr frame::ClassTable table{.name = "Field", .members = members, .defaultMember = "Value"};
            return table;
        }

      private:
        Records& records_;
        std::size_t column_;
    };

    std::shared_ptr<Field> Fields(const Variant& column) {
        askedColumns.push_back(column);
        const std::size_t index = IndexOf(column);
        Step("Fields(" + columns[index] + ")");
        return std::make_shared<Field>(*this, index);
    }

    const frame::ClassTable& Table() const override {
        // `Fields` is a property with an index, so that it answers a reading and a call alike.
        static constexpr std::array members = {
            frame::method<&Records::MoveFirst>("MoveFirst"), frame::method<&Records::MoveNext>("MoveNext"),
            frame::property<&Records::AtEnd>("EOF"), frame::property<&Records::Fields>("Fields")};
        static constexpr frame::ClassTable table{.name = "Records", .members = members};
        return table;
    }

  private:
    void Step(const std::string& step) {
        const int nth = ++times_[step];
        if (steps.size() < 1000) steps.push_back(step);
        if (onStep) onStep(step);
        const auto failure = failures_.find({step, nth});
        if (failure != failures_.end()) throw frame::ControlError(failure->second);
    }
    std::size_t IndexOf(const Variant& column) const {
        if (!column.IsString()) {
            const std::int32_t index = column.ToLong();
            if (index >= 0 && index < static_cast<std::int32_t>(columns.size())) return static_cast<std::size_t>(index);
        } else {
            for (std::size_t index = 0; index < columns.size(); ++index)
                if (frame::EqualsNoCase(columns[index], column.Text())) return index;
        }
        throw frame::ControlError(noColumnNumber, noColumn);
    }

    std::map<std::pair<std::string, int>, frame::ControlError> failures_;
    std::map<std::string, int> times_;
};

inline std::vector<Records::Row> Fruits() { return {{"Pear", 1}, {"Apple", 2}, {"Fig", 3}}; }

inline Variant Call(frame::Object& object, const std::string& name, std::vector<Variant> arguments = {}) {
    return object.Call(name, arguments);
}
inline Variant GetAt(frame::Object& object, const std::string& name, std::int32_t index) {
    Variant at[] = {index};
    return object.Get(name, at);
}
/// What the toolkit reports to a child; the arguments as they stand afterwards.
inline std::vector<Variant> Fire(frame::Object& child, const std::string& event, std::vector<Variant> arguments = {}) {
    const frame::Member* input = child.Table().FindInput(event);
    if (!input) throw frame::ControlError(frame::errors::noSuchMember, event);
    input->call(child, arguments);
    return arguments;
}

/// The items of a list as they stand: "Red=5 | Blue=7".
inline std::string Items(frame::Object& list) {
    std::string line;
    const std::int32_t count = list.Get("ListCount").ToLong();
    for (std::int32_t i = 0; i < count; ++i)
        line += (i == 0 ? "" : " | ") + GetAt(list, "List", i).ToText() + "=" + GetAt(list, "ItemData", i).ToText();
    return line;
}

/// A host with one control, of which a test sees what is raised, reported and yielded, in order.
class Stage {
  public:
    struct Options {
        bool designTime = false;
        const frame::PropertyBag* saved = nullptr;
        std::optional<std::string> toolTip = {};
        frame::FontRef ambientFont = {};
        bool show = true;
    };

    Stage() : Stage(Options()) {}
    explicit Stage(const Options& options) : control_(&Make(options)) { Happened(); }
    ~Stage() { Destroy(); }
    Stage(const Stage&) = delete;
    Stage& operator=(const Stage&) = delete;

    frame::Control& Control() { return *control_; }
    frame::Site& TheSite() { return *control_->Site(); }
    bool Lives() { return host.FindSite(name) != nullptr; }
    void Destroy() {
        if (Lives()) host.Destroy(*control_);
    }

    Variant Get(const std::string& member) { return control_->Get(member); }
    void Put(const std::string& member, const Variant& value) { control_->Put(member, value); }
    std::string Text() { return Get("Text").ToText(); }
    std::int32_t Value() { return Get("Value").ToLong(); }

    std::string Add(const Variant& text, const Variant& value) { return Call(*control_, "AddItem", {text, value}).ToText(); }
    std::string Populate(Records& records, const Variant& textColumn = "Name", const Variant& valueColumn = "Id") {
        return Call(*control_, "Populate", {frame::ObjectRef(records), textColumn, valueColumn}).ToText();
    }
    std::string PopulateWith(Records& records, const Variant& defaultText) {
        return Call(*control_, "Populate", {frame::ObjectRef(records), "Name", "Id", defaultText}).ToText();
    }
    std::string PopulateWith(Records& records, const Variant& defaultText, const Variant& defaultValue) {
        return Call(*control_, "Populate", {frame::ObjectRef(records), "Name", "Id", defaultText, defaultValue}).ToText();
    }
    Variant Remove(const Variant& value) { return Call(*control_, "RemoveItem", {value}); }
    Variant Clear() { return Call(*control_, "Clear"); }

    frame::Object& List(int index) { return *control_->Inner("listItems(" + std::to_string(index) + ")"); }
    frame::Object& Label() { return *control_->Inner("labItem"); }
    std::string ItemsOf(int index) { return Items(List(index)); }
    std::string LabelText() { return Label().Get("Caption").ToText(); }
    std::int32_t ListIndex(int list = 0) { return List(list).Get("ListIndex").ToLong(); }
    /// An item is chosen in a list, as from its drop-down part.
    void Choose(std::int32_t index, int list = 0) { List(list).Put("ListIndex", index); }
    /// What is to be seen: "label", "list 0", "list 1".
    std::string Visible() {
        std::string line;
        const auto add = [&](frame::Object& child, const std::string& word) {
            if (child.Get("Visible").ToBoolean()) line += (line.empty() ? "" : ", ") + word;
        };
        add(Label(), "label");
        add(List(0), "list 0");
        add(List(1), "list 1");
        return line;
    }
    /// All that a call may change: items, choices, label, defaults.
    std::string State() {
        return ItemsOf(0) + " @" + std::to_string(ListIndex(0)) + " / " + ItemsOf(1) + " @" + std::to_string(ListIndex(1)) + " / " +
               LabelText() + " / " + Get("DefaultText").ToText() + "=" + Get("DefaultValue").ToText();
    }

    /// What happened since the last call: "Click", "KeyDown(65, 1)", "changed Text", "yield", parted by blanks.
    std::string Happened() {
        std::string line;
        for (const headless::Log::Entry& entry : host.log.Take()) {
            const std::string kind = entry.at(0).ToText();
            std::string word;
            if (kind == "event") word = entry.at(2).ToText() + Arguments(entry.at(3));
            if (kind == "changed") word = "changed " + entry.at(2).ToText();
            if (kind == "yield") word = kind;
            if (!word.empty()) line += (line.empty() ? "" : " ") + word;
        }
        return line;
    }
    void Reset() { Happened(); }
    /// Runs once, at the next turn of the message loop.
    void AtYield(std::function<void()> run) {
        host.loop.onTurn = [this, run = std::move(run)] {
            const auto once = run;
            host.loop.onTurn = nullptr;
            once();
        };
    }
    /// Runs once, inside the next event.
    void AtEvent(std::function<void()> run) {
        onEvent = [this, run = std::move(run)](frame::EventArguments) {
            const auto once = run;
            onEvent = nullptr;
            once();
        };
    }

    frame::MemoryBag Save() {
        frame::MemoryBag bag;
        control_->WriteProperties(bag);
        return bag;
    }
    /// The value that a save writes under a key; the first where it comes twice.
    Variant Saved(const std::string& key) {
        const frame::MemoryBag bag = Save();
        for (const auto& write : bag.Written())
            if (write.key == key) return write.value;
        return Variant::Missing();
    }

    std::function<void(frame::EventArguments)> onEvent;  ///< the application's handler of every event
    test::HostUnderTest host;

  private:
    static constexpr const char* name = "List1";

    frame::Control& Make(const Options& options) {
        headless::Placing placing{.designTime = options.designTime,
                                  .saved = options.saved,
                                  .width = width,
                                  .height = height,
                                  .ambientFont = options.ambientFont,
                                  .show = options.show};
        if (options.toolTip) placing.extender = {{"ToolTipText", *options.toolTip}};
        placing.onEvent = [this](const std::string&, const frame::EventInfo&, frame::EventArguments arguments) {
            const auto present = onEvent;
            if (present) present(arguments);
        };
        return host.Create(DataListClass(), name, placing);
    }
    static std::string Arguments(const Variant& list) {
        std::string line;
        for (const Variant& value : list.ToArray().items) line += (line.empty() ? "" : ", ") + value.ToText();
        return line.empty() ? line : "(" + line + ")";
    }

    frame::Control* control_;
};

/// A control loaded from these keys.
struct Loaded {
    Loaded(std::initializer_list<std::pair<std::string, Variant>> contents) : bag(frame::MemoryBag::Contents(contents)) {}
    frame::MemoryBag bag;
    Stage stage{Stage::Options{.saved = &bag}};
};

inline std::string ToolTips(Stage& stage) {
    return stage.List(0).Get("ToolTipText").ToText() + " | " + stage.List(1).Get("ToolTipText").ToText() + " | " +
           stage.Label().Get("ToolTipText").ToText();
}

}  // namespace tessel::controls::datalisttest
