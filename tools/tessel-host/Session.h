#pragma once

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "hosts/headless/HeadlessHost.h"
#include "hosts/headless/MemoryRecordset.h"
#include "tools/tessel-host/Json.h"

namespace tessel::tools {

/// What the controls of a session have for a disk.
enum class DiskKind { Memory, Real };

/// A scripted session with one headless host: requests in, replies out. Nothing that it is given ends the program: what
/// cannot be understood or done gets an error reply.
class Session {
  public:
    /// `mostRequests` bounds what one line may set off: the requests inside handlers and forms.
    explicit Session(int mostRequests = 100'000, DiskKind disk = DiskKind::Memory);
    ~Session();

    /// Carries out one line and gives the reply as one line, without its end.
    std::string Answer(std::string_view line);
    /// The reply to a line that was too long to be read.
    std::string AnswerTooLong();

  private:
    using Request = Json;
    struct Handler;
    class ApplicationObject;
    class ScreenObject;

    std::string Reply(Json reply);
    /// Carries out a request: its value, or its error.
    Json Carry(const Request& request);
    Json Attempt(const Request& request);
    Json Value(const Request& request);

    // The requests.
    Json Form(const Request& request);
    Json Sibling(const Request& request);
    Json Create(const Request& request);
    Json Show(const Request& request);
    Json Hide(const Request& request);
    Json Paint(const Request& request);
    Json Save(const Request& request);
    Json Destroy(const Request& request);
    Json Resize(const Request& request);
    Json Ambient(const Request& request);
    Json Get(const Request& request);
    Json Put(const Request& request);
    Json Call(const Request& request);
    Json Fire(const Request& request);
    Json Handle(const Request& request);
    Json Advance(const Request& request);
    Json Random(const Request& request);
    Json Now(const Request& request);
    Json Answers(const Request& request);
    Json Shell(const Request& request);
    Json Disk(const Request& request);
    Json Special(const Request& request);
    Json Recordset(const Request& request);

    // Objects.
    frame::ObjectRef Root(std::string_view name);
    frame::ObjectRef FolderAt(const std::string& path);
    frame::ObjectRef Find(const std::string& path);
    /// The object that a request names. To be held while it is used: a value-like object lives only as long as someone does.
    frame::ObjectRef Target(const Request& request);
    headless::HeadlessSite& SiteOf(const Request& request);
    /// The object that has the member: a control answers by name together with the host's own members for it.
    frame::Object& Holder(frame::Object& object, frame::MemberKey key);

    // Values.
    frame::Variant From(const Json& json);
    std::vector<frame::Variant> Arguments(const Request& request);
    headless::HostObject::Members MembersFrom(const Json& json);
    frame::MemoryBag BagFrom(const Json& json);

    // Events and the log.
    void OnEvent(const std::string& object, const frame::EventInfo& event, frame::EventArguments arguments);
    void RunAll(const Json& requests);
    void GatherLog();

    std::unique_ptr<frame::FileSystem> realDisk_;  // null with the memory disk
    headless::HeadlessHost host_;
    std::vector<std::unique_ptr<headless::HostObject>> siblings_;
    std::vector<std::unique_ptr<headless::MemoryRecordset>> recordsets_;
    std::vector<std::unique_ptr<frame::Object>> modules_;
    std::vector<frame::Object*> sharedModules_;                 // those that the controls of the host share
    std::map<std::string, std::shared_ptr<Handler>> handlers_;  // by object and event, in lower case
    ObjectFinder finder_;
    Json log_ = Json::array();
    const int mostRequests_;
    int depth_ = 0;  // requests that are running one inside the other
    int ran_ = 0;    // requests that the present line has set off
};

}  // namespace tessel::tools
