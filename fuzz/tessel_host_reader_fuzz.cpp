#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <sstream>
#include <string>

#include "tools/tessel-host/Lines.h"
#include "tools/tessel-host/Session.h"

/// Whatever the lines say, each gets one reply, on one line, that is JSON with a `log` and either a `value` or an `error`.
namespace {

using tessel::tools::Json;
using tessel::tools::LineRead;

constexpr int mostLines = 64;
constexpr std::size_t longestLine = 4096;  // short, so that lines that are too long come up too
constexpr int mostRequests = 200;

void CheckReply(const std::string& reply) {
    const Json json = Json::parse(reply, nullptr, false);
    const bool oneOfTwo = json.is_object() && json.contains("value") != json.contains("error");
    if (!oneOfTwo || !json["log"].is_array() || reply.find('\n') != std::string::npos) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    std::istringstream input(std::string(reinterpret_cast<const char*>(data), size));
    tessel::tools::Session session(mostRequests);
    CheckReply(session.Answer(R"({"do":"create","class":"Link","name":"Link1","bag":{"Caption":"Docs","LinkTo":"a.txt"}})"));
    std::string line;
    for (int count = 0; count < mostLines; ++count) {
        const LineRead read = tessel::tools::ReadLine(input, line, longestLine);
        if (read == LineRead::End) break;
        CheckReply(read == LineRead::TooLong ? session.AnswerTooLong() : session.Answer(line));
    }
    return 0;
}
