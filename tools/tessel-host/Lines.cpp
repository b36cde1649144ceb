#include "tools/tessel-host/Lines.h"

#include <streambuf>

namespace tessel::tools {

LineRead ReadLine(std::istream& input, std::string& line, std::size_t longest) {
    using Traits = std::istream::traits_type;
    line.clear();
    bool any = false, tooLong = false;
    std::streambuf& buffer = *input.rdbuf();
    for (auto next = buffer.sbumpc(); !Traits::eq_int_type(next, Traits::eof()); next = buffer.sbumpc()) {
        any = true;
        const char byte = Traits::to_char_type(next);
        if (byte == '\n') break;
        if (line.size() < longest)
            line += byte;
        else
            tooLong = true;
    }
    if (!any) return LineRead::End;
    if (tooLong) return LineRead::TooLong;
    if (!line.empty() && line.back() == '\r') line.pop_back();
    return LineRead::Line;
}

}  // namespace tessel::tools
