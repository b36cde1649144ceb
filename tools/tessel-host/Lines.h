#pragma once

#include <istream>
#include <string>

namespace tessel::tools {

/// A line with more bytes than this is no request; it is passed over without being kept.
inline constexpr std::size_t longestLine = 64u << 20;

enum class LineRead : unsigned char { Line, TooLong, End };

/// Reads the next line without its end (LF, or CR LF) into `line`, which never grows beyond `longest` bytes.
LineRead ReadLine(std::istream& input, std::string& line, std::size_t longest = longestLine);

}  // namespace tessel::tools
