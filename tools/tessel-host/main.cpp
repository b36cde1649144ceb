#include <fstream>
#include <iostream>
#include <string>
#include <vector>

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

int Run(std::istream& input, tessel::tools::DiskKind disk) {
    using tessel::tools::LineRead;
    constexpr int mostRequests = 100'000;
    tessel::tools::Session session(mostRequests, disk);
    std::string line;
    while (true) {
        const LineRead read = tessel::tools::ReadLine(input, line);
        if (read == LineRead::End) return 0;
        if (read == LineRead::Line && line.find_first_not_of(" \t") == std::string::npos) continue;
        std::cout << (read == LineRead::TooLong ? session.AnswerTooLong() : session.Answer(line)) << std::endl;
    }
}

}  // namespace

/// tessel-host [--disk memory|real] [file]: reads requests, one JSON object a line, from the file or from standard input.
int main(int count, char** arguments) {
    KeepEveryByte();
    using tessel::tools::DiskKind;
    std::ios::sync_with_stdio(false);
    const auto usage = [] {
        std::cerr << "usage: tessel-host [--disk memory|real] [file]\n";
        return usageError;
    };
    DiskKind disk = DiskKind::Memory;
    std::vector<std::string> files;
    for (int i = 1; i < count; ++i) {
        const std::string argument = arguments[i];
        if (argument == "--disk") {
            const std::string kind = i + 1 < count ? arguments[++i] : "";
            if (kind != "memory" && kind != "real") return usage();
            disk = kind == "real" ? DiskKind::Real : DiskKind::Memory;
        } else if (argument.starts_with('-')) {
            return usage();
        } else {
            files.push_back(argument);
        }
    }
    if (files.size() > 1) return usage();
    if (files.empty()) return Run(std::cin, disk);
    std::ifstream file(files.front(), std::ios::binary);
    if (!file) {
        std::cerr << "tessel-host: cannot read " << files.front() << '\n';
        return usageError;
    }
    return Run(file, disk);
}
