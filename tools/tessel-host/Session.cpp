#include "tools/tessel-host/Session.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "controls/Classes.h"
#include "fileservices/Collect.h"
#include "fileservices/CommonFile.h"
#include "fileservices/FileIcon.h"
#include "fileservices/FileSys.h"
#include "fileservices/FileSystemObject.h"
#include "fileservices/SpecialFolders.h"
#include "frame/ClassTable.h"
#include "frame/Dates.h"
#include "frame/Text.h"
#include "frame/child/ImageList.h"
#include "tools/tessel-host/DiskRequests.h"
#include "tools/tessel-host/Fields.h"
#include "tools/tessel-host/ObjectPath.h"
#include "tools/tessel-host/RealDisk.h"

namespace tessel::tools {

using frame::ControlError;
using frame::EqualsNoCase;
using frame::Variant;
using headless::HostObject;

namespace {

constexpr int deepestRequest = 100;   // requests inside handlers of requests
constexpr int deepestNesting = 1000;  // brackets inside brackets
constexpr int mostFields = 1000;      // of one JSON object: they are looked up one by one

/// An ambient font is never nothing: null stands for the default one.
frame::FontRef FontFrom(const Variant& value) {
    auto font = frame::FromVariant<frame::FontRef>(value);
    return font ? font : std::make_shared<frame::Font>();
}

Json ErrorReply(const ControlError& error) {
    return {{"error", {{"number", error.Number()}, {"description", frame::ToStrictUtf8(error.Description())}}}};
}

/// A line as JSON, within the limits.
Json Parse(std::string_view line) {
    if (!frame::IsValidUtf8(line)) Refuse("The request is no valid UTF-8");
    std::vector<int> fields;  // of the objects that are open
    const auto check = [&](int depth, Json::parse_event_t event, const Json&) {
        if (depth > deepestNesting) Refuse("The request is nested too deep");
        if (event == Json::parse_event_t::object_start) fields.push_back(0);
        if (event == Json::parse_event_t::object_end) fields.pop_back();
        if (event == Json::parse_event_t::key && ++fields.back() > mostFields) Refuse("An object has too many fields");
        return true;
    };
    Json request = Json::parse(line, check, false);
    if (request.is_discarded()) Refuse("The request is no valid JSON");
    return request;
}

}  // namespace

/// What a script has put in place of the application's handler of an event.
struct Session::Handler {  // NOLINT(bugprone-exception-escape): the JSON library's destructor throws nothing
    Json set, when, run;
    std::optional<int> times;
};

class Session::ApplicationObject final : public frame::Object {
  public:
    explicit ApplicationObject(headless::FixedApplication& application) : application_(application) {}
    std::string PathText() const { return application_.path; }
    void SetPathText(const std::string& value) { application_.path = value; }
    std::string Path() const override { return "App"; }
    const frame::ClassTable& Table() const override {
        static constexpr std::array rows = {frame::property<&ApplicationObject::PathText, &ApplicationObject::SetPathText>("Path")};
        static constexpr frame::ClassTable table{.name = "App", .members = rows};
        return table;
    }

  private:
    headless::FixedApplication& application_;
};

class Session::ScreenObject final : public frame::Object {
  public:
    explicit ScreenObject(headless::FixedApplication& application) : application_(application) {}
    std::int16_t MousePointer() const { return static_cast<std::int16_t>(application_.pointer); }
    void SetMousePointer(std::int16_t value) { application_.pointer = value; }
    std::string Path() const override { return "Screen"; }
    const frame::ClassTable& Table() const override {
        static constexpr std::array rows = {
            frame::property<&ScreenObject::MousePointer, &ScreenObject::SetMousePointer>("MousePointer")};
        static constexpr frame::ClassTable table{.name = "Screen", .members = rows};
        return table;
    }

  private:
    headless::FixedApplication& application_;
};

Session::Session(int mostRequests, DiskKind disk)
    : realDisk_(disk == DiskKind::Real ? MakeRealDisk() : nullptr), host_(realDisk_.get()), mostRequests_(mostRequests) {
    modules_.push_back(std::make_unique<ApplicationObject>(host_.application));
    modules_.push_back(std::make_unique<ScreenObject>(host_.application));
    frame::Host& frame = host_.Frame();
    sharedModules_ = {&frame.Module<fileservices::CommonFile>(), &frame.Module<fileservices::FileSys>(),
                      &frame.Module<fileservices::Collect>(),    &frame.Module<fileservices::SpecialFolders>(),
                      &frame.Module<fileservices::FileIcon>(),   &frame.Module<fileservices::FileSystemObject>()};
    finder_.drive = [this](const std::string& name) {
        return frame::ObjectRef(host_.Frame().Module<fileservices::FileSystemObject>().GetDrive(name));
    };
    finder_.folder = [this](const std::string& path) { return FolderAt(path); };
    finder_.byPath = [this](const std::string& path) { return Find(path); };
    finder_.picture = [this](const std::string& file) { return frame::ObjectRef(host_.Frame().Pictures().LoadPicture(file)); };
}

Session::~Session() = default;

std::string Session::Answer(std::string_view line) {
    ran_ = 0;
    try {
        return Reply(Carry(Parse(line)));
    } catch (const ControlError& error) {
        return Reply(ErrorReply(error));
    } catch (const std::bad_alloc&) {
        return Reply(ErrorReply(ControlError(frame::errors::outOfMemory)));
    }
}

std::string Session::AnswerTooLong() {
    return Reply(ErrorReply(ControlError(frame::errors::invalidCall, "The request is too long")));
}

std::string Session::Reply(Json reply) {
    GatherLog();
    reply["log"] = std::move(log_);
    log_ = Json::array();
    return reply.dump(-1, ' ', false, Json::error_handler_t::replace);
}

Json Session::Carry(const Request& request) {
    auto& reports = host_.errors.reports;
    const std::size_t reported = reports.size();
    Json reply = Attempt(request);
    if (reports.size() > reported) {
        // An error that left a control inside its own event has no other way to the script than this reply.
        if (!reply.contains("error")) reply = ErrorReply(reports[reported].error);
        reports.erase(reports.begin() + static_cast<std::ptrdiff_t>(reported), reports.end());
    }
    return reply;
}

Json Session::Attempt(const Request& request) {
    try {
        return {{"value", Value(request)}};
    } catch (const ControlError& error) {
        return ErrorReply(error);
    } catch (const Json::exception& error) {
        return ErrorReply(ControlError(frame::errors::typeMismatch, error.what()));
    } catch (const std::bad_alloc&) {
        return ErrorReply(ControlError(frame::errors::outOfMemory));
    } catch (const std::exception& error) {
        return ErrorReply(ControlError(frame::errors::internal, error.what()));
    }
}

Json Session::Value(const Request& request) {
    using Method = Json (Session::*)(const Request&);
    static constexpr std::pair<std::string_view, Method> requests[] = {
        {"form", &Session::Form},
        {"sibling", &Session::Sibling},
        {"create", &Session::Create},
        {"show", &Session::Show},
        {"hide", &Session::Hide},
        {"paint", &Session::Paint},
        {"save", &Session::Save},
        {"destroy", &Session::Destroy},
        {"resize", &Session::Resize},
        {"ambient", &Session::Ambient},
        {"get", &Session::Get},
        {"put", &Session::Put},
        {"call", &Session::Call},
        {"fire", &Session::Fire},
        {"handler", &Session::Handle},
        {"advance", &Session::Advance},
        {"random", &Session::Random},
        {"now", &Session::Now},
        {"answers", &Session::Answers},
        {"shell", &Session::Shell},
        {"disk", &Session::Disk},
        {"special", &Session::Special},
        {"recordset", &Session::Recordset},
    };
    if (!request.is_object()) Refuse("A request is an object");
    const std::string name = RequiredText(request, "do");
    const auto found =
        std::find_if(std::begin(requests), std::end(requests), [&](const auto& entry) { return entry.first == name; });
    if (found == std::end(requests)) Refuse("Unknown request \"" + name + "\"");
    if (depth_ >= deepestRequest) Refuse("Requests are nested too deep");
    struct Deeper {
        explicit Deeper(int& count) : depth(count) { ++depth; }
        ~Deeper() { --depth; }
        int& depth;
    } const deeper(depth_);
    return (this->*found->second)(request);
}

Json Session::Form(const Request& request) {
    HostObject::Members members;
    for (const auto& entry : request.items())
        if (entry.key() != "do" && entry.key() != "name")
            members.emplace_back(frame::FromStrictUtf8(entry.key()), From(entry.value()));
    const std::string name = RequiredText(request, "name");
    if (Root(name).Get() && !host_.FindForm(name)) throw ControlError(frame::errors::keyInUse);
    host_.NewForm(name, std::move(members));
    return frame::ToStrictUtf8(name);
}

Json Session::Sibling(const Request& request) {
    const std::string name = NameIn(request);
    HostObject::Members members{{"Name", name}};
    std::string path = name;
    if (const Json* index = FieldOf(request, "index"); index && !index->is_null()) {
        const std::int32_t number = From(*index).ToLong();
        path += "(" + frame::Decimal(number) + ")";
        members.emplace_back("Index", number);
    }
    if (Root(path).Get()) throw ControlError(frame::errors::keyInUse);
    if (const Json* props = FieldOf(request, "props")) {
        for (auto& given : MembersFrom(ObjectIn(*props, "props"))) {
            std::erase_if(members, [&](const auto& member) { return EqualsNoCase(member.first, given.first); });
            members.push_back(std::move(given));
        }
    }
    if (FlagIn(request, "surface", false))
        siblings_.push_back(std::make_unique<headless::SurfaceObject>(host_.Frame(), path, std::move(members)));
    else
        siblings_.push_back(std::make_unique<HostObject>(path, std::move(members)));
    host_.Form().Add(*siblings_.back());
    return frame::ToStrictUtf8(path);
}

Json Session::Create(const Request& request) {
    const std::string className = RequiredText(request, "class");
    const frame::ControlClass* controlClass = controls::FindControlClass(className);
    if (!controlClass) Refuse("Unknown class \"" + className + "\"");
    const std::string name = NameIn(request);
    if (Root(name).Get()) throw ControlError(frame::errors::keyInUse);

    headless::Placing placing;
    if (const Json* mode = FieldOf(request, "mode")) {
        const std::string text = TextOf(*mode, "mode");
        if (text != "run" && text != "design") Refuse(R"("mode" must be "run" or "design")");
        placing.designTime = text == "design";
    }
    frame::MemoryBag bag;
    if (const Json* saved = FieldOf(request, "bag"); saved && !saved->is_null()) {
        bag = BagFrom(ObjectIn(*saved, "bag"));
        placing.saved = &bag;
    }
    if (const Json* width = FieldOf(request, "width")) placing.width = From(*width).ToSingle();
    if (const Json* height = FieldOf(request, "height")) placing.height = From(*height).ToSingle();
    if (const Json* extender = FieldOf(request, "extender")) placing.extender = MembersFrom(ObjectIn(*extender, "extender"));
    if (const Json* ambient = FieldOf(request, "ambient")) {
        for (const auto& [key, value] : MembersFrom(ObjectIn(*ambient, "ambient"))) {
            if (EqualsNoCase(key, "Font"))
                placing.ambientFont = FontFrom(value);
            else if (EqualsNoCase(key, "DisplayName"))
                placing.displayName = value.ToText();
            else
                Refuse("Unknown ambient property \"" + key + "\"");
        }
    }
    placing.show = FlagIn(request, "show", true);
    placing.onEvent = [this](const std::string& object, const frame::EventInfo& event, frame::EventArguments arguments) {
        OnEvent(object, event, arguments);
    };
    host_.Create(*controlClass, name, placing);
    return frame::ToStrictUtf8(name);
}

Json Session::Show(const Request& request) {
    auto& site = SiteOf(request);
    if (site.Visible())
        site.Show();
    else
        site.SetVisible(true);
    return nullptr;
}

Json Session::Hide(const Request& request) {
    auto& site = SiteOf(request);
    if (!site.Visible())
        site.Hide();
    else
        site.SetVisible(false);
    return nullptr;
}

Json Session::Paint(const Request& request) {
    SiteOf(request).Paint();
    return nullptr;
}

Json Session::Save(const Request& request) {
    const frame::MemoryBag bag = host_.Save(SiteOf(request).Control());
    Json written = Json::array();
    for (const auto& write : bag.Written()) written.push_back({write.key, ToJson(write.value), ToJson(write.otherwise)});
    Json kept = Json::object();
    for (const auto& [key, value] : bag.Kept()) kept[key] = ToJson(value);
    return {{"written", std::move(written)}, {"bag", std::move(kept)}};
}

Json Session::Destroy(const Request& request) {
    const std::string name = RequiredText(request, "of");
    if (auto* site = host_.FindSite(name)) {
        host_.Destroy(site->Control());
        return nullptr;
    }
    const auto sibling =
        std::find_if(siblings_.begin(), siblings_.end(), [&](const auto& object) { return EqualsNoCase(object->Path(), name); });
    if (sibling == siblings_.end()) throw ControlError(frame::errors::objectRequired, "There is no object \"" + name + "\"");
    host_.TakeOffForms(**sibling);
    siblings_.erase(sibling);
    return nullptr;
}

Json Session::Resize(const Request& request) {
    auto& site = SiteOf(request);
    const auto extent = [&](const char* name, float present) {
        const Json* given = FieldOf(request, name);
        return given ? From(*given).ToSingle() : present;
    };
    const float width = extent("width", site.Width());
    site.SetSize(width, extent("height", site.Height()));
    return nullptr;
}

Json Session::Ambient(const Request& request) {
    auto& site = SiteOf(request);
    const std::string name = RequiredText(request, "name");
    const Variant value = From(Required(request, "value"));
    if (EqualsNoCase(name, "UserMode"))
        site.SetUserMode(value.ToBoolean());
    else if (EqualsNoCase(name, "Font"))
        site.SetAmbientFont(FontFrom(value));
    else if (EqualsNoCase(name, "DisplayName"))
        site.SetDisplayName(value.ToText());
    else
        throw ControlError(frame::errors::noSuchMember);
    site.AmbientChanged(name);
    return nullptr;
}

namespace {

/// A member's name, or its dispatch number.
frame::MemberKey KeyOf(const Json& name) {
    if (name.is_number_integer()) {
        const auto number = name.get<std::int64_t>();
        if (number != static_cast<int>(number)) throw ControlError(frame::errors::noSuchMember);
        return static_cast<int>(number);
    }
    if (!name.is_string()) Refuse("\"name\" must be a string or a number");
    return std::string_view(name.get_ref<const std::string&>());
}

/// A picture that a child has from an image list beside it is named by that image.
Json ValueOf(const frame::Object& holder, const Variant& value) {
    const auto* child = dynamic_cast<const frame::ChildControl*>(&holder);
    if (!child || value.Type() != frame::VarType::Object) return ToJson(value);
    const frame::ObjectRef object = value.ToObject();
    const auto* picture = dynamic_cast<const frame::Picture*>(object.Get());
    if (!picture) return ToJson(value);
    for (frame::ChildControl* other : child->Owner().Children()) {
        const auto* images = dynamic_cast<const child::ImageList*>(other);
        child::ListImage* image = images ? images->ListImages.FindPicture(*picture) : nullptr;
        if (image) return ToJson(frame::ObjectRef(*image));
    }
    return ToJson(value);
}

}  // namespace

Json Session::Get(const Request& request) {
    const frame::ObjectRef object = Target(request);
    const frame::MemberKey key = KeyOf(Required(request, "name"));
    auto arguments = Arguments(request);
    frame::Object& holder = Holder(*object, key);
    if (!key.ByNumber() && arguments.empty() && !holder.Has(key))
        if (const frame::ObjectRef inner = object->Inner(key.Name()); inner.Get()) return ToJson(inner);
    return ValueOf(holder, holder.Get(key, arguments));
}

Json Session::Put(const Request& request) {
    const frame::ObjectRef object = Target(request);
    const frame::MemberKey key = KeyOf(Required(request, "name"));
    auto arguments = Arguments(request);
    Holder(*object, key).Put(key, From(Required(request, "value")), arguments);
    return nullptr;
}

namespace {

Json WithArguments(Json result, const frame::Member& member, const std::vector<Variant>& arguments) {
    const auto parameters = member.parameters.All();
    if (std::none_of(parameters.begin(), parameters.end(), [](const frame::Parameter& parameter) { return parameter.byReference; }))
        return result;
    Json after = Json::array();
    for (const Variant& argument : arguments) after.push_back(ToJson(argument));
    return {{"result", std::move(result)}, {"args", std::move(after)}};
}

}  // namespace

Json Session::Call(const Request& request) {
    const frame::ObjectRef object = Target(request);
    const frame::MemberKey key = KeyOf(Required(request, "name"));
    auto arguments = Arguments(request);
    frame::Object& holder = Holder(*object, key);
    const frame::Member* member = holder.Table().Find(key);
    Json result = ToJson(holder.Call(key, arguments));
    return member ? WithArguments(std::move(result), *member, arguments) : result;
}

Json Session::Fire(const Request& request) {
    const frame::ObjectRef object = Target(request);
    const std::string event = RequiredText(request, "event");
    const frame::Member* input = object->Table().FindInput(event);
    if (!input) throw ControlError(frame::errors::noSuchMember, "\"" + event + "\" is no event of " + object->Path());
    auto arguments = Arguments(request);
    const Json result = WithArguments(ToJson(input->call(*object, arguments)), *input, arguments);
    return result.is_object() && result.contains("args") ? result["args"] : result;
}

namespace {

std::string HandlerKey(std::string_view object, std::string_view event) {
    return frame::FoldCase(object) + "\n" + frame::FoldCase(event);
}

}  // namespace

Json Session::Handle(const Request& request) {
    const std::string object = RequiredText(request, "of");
    const std::string event = RequiredText(request, "event");
    if (const auto* site = host_.FindSite(object); site && !site->Control().Table().FindEvent(event))
        throw ControlError(frame::errors::noSuchMember, object + " has no event \"" + event + "\"");
    Handler handler;
    if (const Json* set = FieldOf(request, "set")) handler.set = ObjectIn(*set, "set");
    if (const Json* when = FieldOf(request, "when")) handler.when = ObjectIn(*when, "when");
    if (const Json* times = FieldOf(request, "times")) handler.times = From(*times).ToLong();
    handler.run = ListIn(request, "run");
    handlers_[HandlerKey(object, event)] = std::make_shared<Handler>(std::move(handler));
    return nullptr;
}

Json Session::Advance(const Request& request) {
    constexpr double longest = 1e12;
    const double milliseconds = From(Required(request, "ms")).ToDouble();
    if (!(milliseconds >= 0 && milliseconds <= longest)) Refuse("\"ms\" must be from 0 to 1e12 milliseconds");
    host_.clock.Advance(static_cast<std::int64_t>(milliseconds));
    return nullptr;
}

Json Session::Random(const Request& request) {
    std::vector<float> values;
    for (const Json& value : ListIn(request, "values")) {
        const float number = From(value).ToSingle();
        if (!(number >= 0 && number <= 1)) Refuse("A random number is at least 0 and below 1");
        values.push_back(std::min(number, std::nextafter(1.0f, 0.0f)));  // one that rounds to 1 stays below it
    }
    host_.random.queue.insert(host_.random.queue.end(), values.begin(), values.end());
    return nullptr;
}

Json Session::Now(const Request& request) {
    const auto now = frame::ParseDate(RequiredText(request, "value"));
    if (!now) throw ControlError(frame::errors::typeMismatch);
    host_.clock.SetNow(*now);
    return nullptr;
}

Json Session::Answers(const Request& request) {
    for (const Json& answer : ListIn(request, "msgbox")) host_.dialogs.answers.push_back(From(answer).ToLong());
    for (const Json& file : ListIn(request, "dialog"))
        host_.dialogs.fileNames.push_back(file.is_null() ? std::nullopt : std::optional(TextOf(file, "dialog")));
    for (const Json& entry : ListIn(request, "popup")) {
        if (entry.is_null())
            host_.menus.picks.emplace_back();
        else
            host_.menus.picks.emplace_back([this, path = TextOf(entry, "popup")] {
                // The entry runs inside the control that showed the menu: its failure is reported as theirs are.
                const Json reply = Carry({{"do", "fire"}, {"of", frame::ToStrictUtf8(path)}, {"event", "Click"}});
                if (const Json* error = FieldOf(reply, "error"))
                    host_.errors.Unhandled(ControlError((*error)["number"], (*error)["description"]), path);
            });
    }
    for (const Json& form : ListIn(request, "form")) {
        if (!form.is_array()) Refuse("\"form\" must be a list of lists");
        host_.dialogs.forms.emplace_back([this, form] { RunAll(form); });
    }
    return nullptr;
}

Json Session::Shell(const Request& request) {
    for (const Json& code : ListIn(request, "execute")) host_.shell.executeResults.push_back(From(code).ToLong());
    for (const Json& given : ListIn(request, "operation")) {
        frame::FileOperationResult result;
        if (given.is_object()) {
            if (const Json* code = FieldOf(given, "return")) result.code = From(*code).ToLong();
            result.aborted = FlagIn(given, "aborted", false);
            if (const Json* error = FieldOf(given, "error")) result.systemError = From(*error).ToLong();
        } else {
            result.code = From(given).ToLong();
        }
        host_.shell.operationResults.push_back(result);
    }
    for (const Json& known : ListIn(request, "icon")) host_.pictures.icons.push_back(From(known).ToBoolean());
    return nullptr;
}

Json Session::Disk(const Request& request) {
    if (realDisk_) Refuse("The memory disk is not in use");
    return CarryOutDisk(host_.files, request, [this](const Json& json) { return From(json); });
}

Json Session::Special(const Request& request) {
    const std::string name = RequiredText(request, "name");
    std::string path = RequiredText(request, "path");
    const int number = frame::SpecialFolderNumber(name);
    if (number < 0) Refuse("There is no special folder \"" + name + "\"");
    if (realDisk_)
        SetSpecialFolder(*realDisk_, number, std::move(path));
    else
        host_.files.SetSpecialFolder(number, std::move(path));
    return nullptr;
}

Json Session::Recordset(const Request& request) {
    const std::string name = NameIn(request);
    std::vector<std::string> columns;
    for (const Json& column : ListIn(request, "columns")) columns.push_back(TextOf(column, "columns"));
    std::vector<headless::MemoryRecordset::Row> rows;
    for (const Json& row : ListIn(request, "rows")) {
        if (!row.is_array()) Refuse("\"rows\" must be a list of lists");
        auto& values = rows.emplace_back();
        for (const Json& value : row) values.push_back(From(value));
    }
    auto made = std::make_unique<headless::MemoryRecordset>(name, std::move(columns), std::move(rows));
    std::erase_if(recordsets_, [&](const auto& known) { return EqualsNoCase(known->Path(), name); });
    if (Root(name).Get()) throw ControlError(frame::errors::keyInUse);
    recordsets_.push_back(std::move(made));
    return ToJson(frame::ObjectRef(*recordsets_.back()));
}

frame::ObjectRef Session::Root(std::string_view name) {
    if (auto* site = host_.FindSite(name)) return frame::ObjectRef(site->Control());
    for (const auto& sibling : siblings_)
        if (EqualsNoCase(sibling->Path(), name)) return frame::ObjectRef(*sibling);
    for (const auto& recordset : recordsets_)
        if (EqualsNoCase(recordset->Path(), name)) return frame::ObjectRef(*recordset);
    if (auto* form = host_.FindForm(name)) return frame::ObjectRef(*form);
    for (const auto& module : modules_)
        if (EqualsNoCase(module->Path(), name)) return frame::ObjectRef(*module);
    for (frame::Object* module : sharedModules_)
        if (EqualsNoCase(module->Path(), name)) return frame::ObjectRef(*module);
    return {};
}

/// A folder by its path, whether it is there or not: routines are asked about what has gone too.
frame::ObjectRef Session::FolderAt(const std::string& path) {
    const auto& files = host_.Frame().Module<fileservices::FileSystemObject>();
    if (files.FolderExists(path)) return frame::ObjectRef(files.GetFolder(path));
    return frame::ObjectRef(std::make_shared<fileservices::Folder>(host_.Frame(), path));
}

frame::ObjectRef Session::Find(const std::string& path) {
    const auto steps = ParseObjectPath(path);
    const auto missing = [&]() -> frame::ObjectRef {
        throw ControlError(frame::errors::objectRequired, "There is no object \"" + path + "\"");
    };
    frame::ObjectRef object = Root(steps.front().whole);
    bool keyed = steps.front().key.has_value() && !object.Get();
    if (keyed) object = Root(steps.front().name);
    for (std::size_t i = 0; i < steps.size(); ++i) {
        const PathStep& step = steps[i];
        if (!object.Get()) return missing();
        if (i > 0) {
            frame::ObjectRef inner = object->Inner(step.whole);
            keyed = step.key.has_value() && !inner.Get();
            if (keyed) {
                Variant key[] = {*step.key};
                if (const frame::Member* member = object->Table().Find(step.name); member && member->parameters.count == 1) {
                    object = object->Call(step.name, key).ToObject();
                    continue;
                }
                inner = object->Inner(step.name);
            }
            object = inner;
            if (!object.Get()) return missing();
        }
        if (keyed) {
            Variant key[] = {*step.key};
            object = object->Call("Item", key).ToObject();
        }
    }
    return object.Get() ? object : missing();
}

frame::ObjectRef Session::Target(const Request& request) { return Find(RequiredText(request, "of")); }

headless::HeadlessSite& Session::SiteOf(const Request& request) {
    const std::string name = RequiredText(request, "of");
    auto* site = host_.FindSite(name);
    if (!site) throw ControlError(frame::errors::objectRequired, "There is no control \"" + name + "\"");
    return *site;
}

frame::Object& Session::Holder(frame::Object& object, frame::MemberKey key) {
    const auto* control = dynamic_cast<const frame::Control*>(&object);
    auto* site = control ? host_.SiteOf(*control) : nullptr;
    return site && !key.ByNumber() ? site->Extender() : object;
}

Variant Session::From(const Json& json) { return FromJson(json, finder_); }

std::vector<Variant> Session::Arguments(const Request& request) {
    std::vector<Variant> arguments;
    for (const Json& argument : ListIn(request, "args")) arguments.push_back(From(argument));
    return arguments;
}

HostObject::Members Session::MembersFrom(const Json& json) {
    HostObject::Members members;
    for (const auto& entry : json.items()) members.emplace_back(frame::FromStrictUtf8(entry.key()), From(entry.value()));
    return members;
}

frame::MemoryBag Session::BagFrom(const Json& json) { return MembersFrom(json); }

void Session::OnEvent(const std::string& object, const frame::EventInfo& event, frame::EventArguments arguments) {
    const auto found = handlers_.find(HandlerKey(object, event.name));
    if (found == handlers_.end()) return;
    const std::shared_ptr<Handler> handler = found->second;  // a request that runs inside may replace it
    const auto argumentNamed = [&](const std::string& name) -> const frame::EventArgument& {
        const auto parameters = event.parameters.All();
        const auto at = std::find_if(parameters.begin(), parameters.end(),
                                     [&](const frame::Parameter& parameter) { return EqualsNoCase(parameter.name, name); });
        if (at == parameters.end()) throw ControlError(frame::errors::noSuchMember, "The event has no argument \"" + name + "\"");
        return arguments[static_cast<std::size_t>(at - parameters.begin())];
    };
    for (const auto& entry : handler->when.items())
        if (!(argumentNamed(entry.key()).Get() == From(entry.value()))) return;
    if (handler->times && *handler->times <= 0) return;
    if (handler->times) --*handler->times;
    for (const auto& entry : handler->set.items()) argumentNamed(entry.key()).Set(From(entry.value()));
    RunAll(handler->run);
}

void Session::RunAll(const Json& requests) {
    for (const Json& request : requests) {
        if (++ran_ > mostRequests_) Refuse("One line sets off too many requests");
        Json reply = Carry(request);
        GatherLog();
        log_.push_back({"reply", std::move(reply)});
    }
}

void Session::GatherLog() {
    for (const auto& entry : host_.log.Take()) {
        Json line = Json::array();
        for (const Variant& value : entry) line.push_back(ToJson(value));
        log_.push_back(std::move(line));
    }
}

}  // namespace tessel::tools
