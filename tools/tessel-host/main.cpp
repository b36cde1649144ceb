#include <fstream>
#include <iostream>
#include <string>

#include "tools/tessel-host/Lines.h"
#include "tools/tessel-host/Session.h"

#ifdef _WIN32
#include <fcntl.h>
#include <io.h>
#include <stdio.h>
#endif

namespace {

constexpr int usageError = 2;

/// Where the system would change line ends, and end the input at a control character: every byte as it stands.
void KeepEveryByte() {
#ifdef _WIN32
    _setmode(_fileno(stdin), _O_BINARY);
    _setmode(_fileno(stdout), _O_BINARY);
#endif
}

int Run(std::istream& input) {
    using tessel::tools::LineRead;
    tessel::tools::Session session;
    std::string line;
    while (true) {
        const LineRead read = tessel::tools::ReadLine(input, line);
        if (read == LineRead::End) return 0;
        if (read == LineRead::Line && line.find_first_not_of(" \t") == std::string::npos) continue;
        std::cout << (read == LineRead::TooLong ? session.AnswerTooLong() : session.Answer(line)) << std::endl;
    }
}

}  // namespace

/// tessel-host [file]: reads requests, one JSON object a line, from the file or from standard input.
int main(int count, char** arguments) {
    KeepEveryByte();
    std::ios::sync_with_stdio(false);
    if (count > 2 || (count == 2 && arguments[1][0] == '-')) {
        std::cerr << "usage: tessel-host [file]\n";
        return usageError;
    }
    if (count == 1) return Run(std::cin);
    std::ifstream file(arguments[1], std::ios::binary);
    if (!file) {
        std::cerr << "tessel-host: cannot read " << arguments[1] << '\n';
        return usageError;
    }
    return Run(file);
}
