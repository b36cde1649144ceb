#include "tools/tessel-host/DiskRequests.h"

#include <optional>

#include "frame/Dates.h"
#include "tools/tessel-host/Fields.h"

namespace tessel::tools {

using headless::MemoryDisk;

namespace {

/// The optional fields of one request.
class Reader {
  public:
    Reader(const Json& request, const std::function<frame::Variant(const Json&)>& read) : request_(request), read_(read) {}

    std::optional<std::string> Text(const char* name) const {
        const Json* field = FieldOf(request_, name);
        return field ? std::optional(TextOf(*field, name)) : std::nullopt;
    }
    std::optional<bool> Flag(const char* name) const {
        return FieldOf(request_, name) ? std::optional(FlagIn(request_, name, false)) : std::nullopt;
    }
    std::optional<int> Number(const char* name) const {
        const Json* field = FieldOf(request_, name);
        return field ? std::optional(read_(*field).ToLong()) : std::nullopt;
    }
    std::optional<std::int64_t> Bytes(const char* name) const {
        constexpr double most = 1e18;
        const Json* field = FieldOf(request_, name);
        if (!field || field->is_null()) return {};
        const double bytes = read_(*field).ToDouble();
        if (!(bytes >= 0 && bytes <= most)) Refuse(std::string("\"") + name + "\" must be from 0 to 1e18 bytes");
        return static_cast<std::int64_t>(bytes);
    }
    std::optional<std::int64_t> Moment(const char* name) const {
        const auto text = Text(name);
        if (!text) return {};
        const auto date = frame::ParseDate(*text);
        if (!date) throw frame::ControlError(frame::errors::typeMismatch);
        return headless::SecondsOf(*date);
    }
    std::optional<std::pair<float, float>> Size(const char* name) const {
        const Json* field = FieldOf(request_, name);
        if (!field) return {};
        if (!field->is_array() || field->size() != 2) Refuse(std::string("\"") + name + "\" must be a width and a height");
        const float width = read_((*field)[0]).ToSingle(), height = read_((*field)[1]).ToSingle();
        if (!(width >= 0 && height >= 0)) Refuse(std::string("\"") + name + "\" must not be below 0");
        return std::pair(width, height);
    }

  private:
    const Json& request_;
    const std::function<frame::Variant(const Json&)>& read_;
};

MemoryDisk::DriveFacts DriveFactsOf(const Reader& fields) {
    return {.type = fields.Number("type"),
            .volume = fields.Text("volume"),
            .share = fields.Text("share"),
            .ready = fields.Flag("ready"),
            .readOnly = fields.Flag("readonly")};
}

MemoryDisk::Facts FactsOf(const Reader& fields) {
    return {.attributes = fields.Number("attributes"),
            .size = fields.Bytes("size"),
            .contents = fields.Text("text"),
            .created = fields.Moment("created"),
            .modified = fields.Moment("modified"),
            .accessed = fields.Moment("accessed"),
            .type = fields.Text("type"),
            .unreadable = fields.Flag("unreadable"),
            .picture = fields.Size("picture")};
}

Json ListOf(MemoryDisk& disk, const std::string& folder) {
    std::vector<MemoryDisk::Listed> all;
    disk.ListTree(folder, all).Check();
    Json list = Json::array();
    for (const auto& entry : all)
        list.push_back({{"path", frame::ToStrictUtf8(entry.path)}, {"size", entry.size}, {"attributes", entry.attributes}});
    return list;
}

}  // namespace

Json CarryOutDisk(MemoryDisk& disk, const Json& request, const std::function<frame::Variant(const Json&)>& read) {
    const Reader fields(request, read);
    if (const auto drive = fields.Text("drive")) {
        disk.SetDrive(*drive, DriveFactsOf(fields)).Check();
    } else if (const auto folder = fields.Text("folder")) {
        disk.SetFolder(*folder, FactsOf(fields)).Check();
    } else if (const auto file = fields.Text("file")) {
        disk.SetFile(*file, FactsOf(fields)).Check();
    } else if (const auto removed = fields.Text("remove")) {
        disk.Remove(*removed).Check();
    } else if (const auto listed = fields.Text("list")) {
        return ListOf(disk, *listed);
    } else if (FieldOf(request, "free")) {
        disk.SetFree(fields.Bytes("free"));
    } else {
        Refuse("A disk request names a drive, a folder, a file, what it removes or lists, or the free space");
    }
    return nullptr;
}

}  // namespace tessel::tools
