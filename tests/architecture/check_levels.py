#!/usr/bin/env python3
"""Checks what no compiler does: that includes go down the levels only, that the neutral folders see the standard library
alone and keep no mutable statics, and that each header is guarded.

    check_levels.py [ROOT]      prints one line for each offence; exit status 1 when there is one
    check_levels.py --self-test tries each rule on small trees that break it, and on clean ones
"""
import pathlib
import re
import sys
import tempfile

# Each level with the levels that it may include besides itself. A star stands for one folder name, and the most exact
# entry counts. What is not listed (tests, benchmarks, fuzzing programs) may include anything.
NEUTRAL_BASE = ["frame", "frame/child"]
ANY_CONTROL = [*NEUTRAL_BASE, "fileservices", "controls/*", "controls"]
LEVELS = {
    "frame": [],
    "frame/child": ["frame"],
    "fileservices": NEUTRAL_BASE,
    "controls/*": NEUTRAL_BASE,
    "controls/fileview": [*NEUTRAL_BASE, "fileservices"],
    "controls/folderview": [*NEUTRAL_BASE, "fileservices"],
    "controls": [*NEUTRAL_BASE, "controls/*"],
    "hosts/headless": ANY_CONTROL,
    "hosts/posix": [*NEUTRAL_BASE, "fileservices"],
    "hosts/qt": [*ANY_CONTROL, "hosts/posix"],
    "hosts/qt/designer": [*ANY_CONTROL, "hosts/posix", "hosts/qt"],
    "tools/*": [*ANY_CONTROL, "hosts/*"],
    "apps/*": [*ANY_CONTROL, "hosts/*"],
}
NEUTRAL = ("frame", "fileservices", "controls")
SOURCES = {".h", ".cpp", ".inc"}

STANDARD_HEADERS = set("""
    algorithm any array atomic barrier bit bitset cassert cctype cerrno cfenv cfloat charconv chrono cinttypes climits clocale
    cmath codecvt compare complex concepts condition_variable coroutine csetjmp csignal cstdarg cstddef cstdint cstdio cstdlib
    cstring ctime cuchar cwchar cwctype deque exception execution filesystem format forward_list fstream functional future
    initializer_list iomanip ios iosfwd iostream istream iterator latch limits list locale map memory memory_resource mutex new
    numbers numeric optional ostream queue random ranges ratio regex scoped_allocator semaphore set shared_mutex
    source_location span sstream stack stdexcept stop_token streambuf string string_view strstream syncstream system_error
    thread tuple type_traits typeindex typeinfo unordered_map unordered_set utility valarray variant vector version
    """.split())

COMMENT_OR_LITERAL = re.compile(
    r'//[^\n]*|/\*.*?\*/|R"(?P<mark>[^()\s\\]*)\(.*?\)(?P=mark)"|"(?:\\.|[^"\\\n])*"|(?<![0-9A-Fa-f])\'(?:\\.|[^\'\\\n])+\'', re.S)
INCLUDE = re.compile(r'^\s*#\s*include\s*(?P<what>.+?)\s*$')


def fits(pattern, level):
    return re.fullmatch(pattern.replace("*", "[^/]+"), level) is not None


def level_of(path):
    """The level of a file by the folder it stands in, or None where anything goes."""
    folder = pathlib.PurePosixPath(path).parent
    for candidate in [folder, *folder.parents]:
        if str(candidate) in LEVELS or any(fits(pattern, str(candidate)) for pattern in LEVELS):
            return str(candidate)
    return None


def may_include(level, other):
    rule = level if level in LEVELS else next(pattern for pattern in LEVELS if fits(pattern, level))
    return other == level or other is not None and any(fits(pattern, other) for pattern in LEVELS[rule])


def without_comments(text, keep_literals):
    """The text with comments, and literals too, as blanks; its lines keep their numbers."""
    def blank(match):
        found = match.group()
        if not found.startswith("/"):
            if keep_literals:
                return found
            return '""' + re.sub(r"[^\n]", "", found)
        return " " + re.sub(r"[^\n]", "", found)
    return COMMENT_OR_LITERAL.sub(blank, text)


def included_file(root, path, what):
    """The project's file that an include names, from the root or beside the including file; None when it names none."""
    for start in (root, (root / path).parent):
        file = (start / what).resolve()
        if file.is_file() and file.is_relative_to(root):
            return file.relative_to(root).as_posix()
    return None


def check_includes(root, path, text):
    level = level_of(path)
    neutral = path.split("/")[0] in NEUTRAL
    for number, line in enumerate(without_comments(text, keep_literals=True).split("\n"), 1):
        include = INCLUDE.match(line)
        if not include:
            continue
        what = include["what"]
        name = what[1:-1] if what[0] + what[-1] in ('""', "<>") else None
        target = name and included_file(root, path, name)
        if target:
            if level and not may_include(level, level_of(target)):
                yield f"{path}:{number}: {level} must not include {target}"
        elif neutral and not (what[0] == "<" and name in STANDARD_HEADERS):
            yield f"{path}:{number}: {what} is neither of the standard library nor a file of the project"


def statements(code):
    """Yields (line, scope, text) for each statement up to its ";" or "{"; the scope it stands in is "namespace", "class" or
    "body" (a function's, an initialiser's, an enumeration's)."""
    scope, parentheses, start, outer = "namespace", 0, 0, []
    for match in re.finditer(r"[(){};]", code):
        mark = match.group()
        if mark in "()":
            parentheses += 1 if mark == "(" else -1
            continue
        if mark == ";" and parentheses > 0:  # of a for
            continue
        raw = code[start:match.start()]
        text = without_template_arguments(" ".join(raw.split()))
        start = match.end()
        if mark == "}":
            if outer:
                scope, parentheses = outer.pop()
            continue
        yield code.count("\n", 0, match.start() - len(raw.lstrip())) + 1, scope, text
        if mark == "{":
            outer.append((scope, parentheses))
            scope, parentheses = scope_opened_by(text, scope), 0


def without_template_arguments(text):
    shorter = re.sub(r"<[^<>]*>", " ", text)
    return text if shorter == text else without_template_arguments(shorter)


def scope_opened_by(text, scope):
    if scope == "body":
        return "class" if re.match(r"(struct|class|union)\b[^()=]*$", text) else "body"
    if re.search(r"\bnamespace\b|\bextern \"\"$", text):
        return "namespace"
    return "class" if re.search(r"\b(?<!enum )(struct|class|union)\b[^()=]*$", text) else "body"


def is_mutable_static(scope, text):
    """Whether a statement declares a variable that lives as long as the program and can change."""
    text = re.sub(r"^((public|private|protected)\s*:\s*)+", "", text)
    named_so = re.search(r"\b(static|thread_local)\b", text) is not None
    declaration = re.split(r"=(?!=)", text)[0]
    if scope == "class" and (not named_so or "(" in declaration):
        return False
    if scope == "body" and not named_so:
        return False
    if scope == "namespace":
        if re.search(r"\b(using|typedef|class|struct|union|enum|namespace|concept|static_assert|extern|friend|operator)\b", declaration):
            return False
        if "(" in declaration or not re.match(r"[\w:]+[\s&*]+[\w:]", declaration):
            return False
    declaration = declaration.split("(")[0]
    if re.search(r"\bconstexpr\b", declaration):
        return False
    # Of a pointer the const behind the star counts, of a reference the one before the sign.
    constant_part = declaration.rsplit("*", 1)[-1] if "*" in declaration else declaration.split("&")[0]
    return not re.search(r"\bconst\b", constant_part)


def check_statics(path, text):
    code = without_comments(text, keep_literals=False)
    code = re.sub(r"^[ \t]*#(?:[^\n]*\\\n)*[^\n]*", lambda found: "\n" * found.group().count("\n"), code, flags=re.M)
    for line, scope, statement in statements(code):
        if is_mutable_static(scope, statement):
            yield f"{path}:{line}: state that every host would share: {statement}"


def check_guard(path, text):
    if text.lstrip().split("\n")[0].strip() != "#pragma once":
        yield f"{path}:1: a header begins with #pragma once"


def offences(root):
    root = pathlib.Path(root).resolve()
    for folder in sorted({pattern.split("/")[0] for pattern in LEVELS}):
        for file in sorted((root / folder).rglob("*")):
            if file.suffix not in SOURCES or not file.is_file():
                continue
            path, text = file.relative_to(root).as_posix(), file.read_text(encoding="utf-8")
            yield from check_includes(root, path, text)
            if folder in NEUTRAL:
                yield from check_statics(path, text)
            if file.suffix == ".h":
                yield from check_guard(path, text)


# What the self-test tries: a name, the files of a tree, and a part of the one line that it must give, or None for a clean one.
# The files of BASE stand in every tree.
BASE = {
    "frame/Base.h": "#pragma once\n", "frame/child/Child.h": "#pragma once\n", "fileservices/Files.h": "#pragma once\n",
    "controls/All.h": "#pragma once\n", "controls/link/Link.h": "#pragma once\n",
    "controls/fileview/FileView.h": "#pragma once\n", "hosts/headless/Headless.h": "#pragma once\n",
    "hosts/posix/Posix.h": "#pragma once\n", "hosts/qt/Qt.h": "#pragma once\n",
}


def including(path, what):
    return {path: f"#include {what}\n"}


def in_frame(code):
    return {"frame/A.cpp": code}


TREES = [
    ("a clean tree", {
        "frame/A.cpp": '#include "frame/Base.h"\n#include <vector>\n',
        "controls/All.cpp": '#include "controls/All.h"\n#include "controls/link/Link.h"\n',
        "frame/child/A.cpp": '#include "frame/Base.h"\n#include "frame/child/Child.h"\n',
        "controls/fileview/A.cpp": '#include "fileservices/Files.h"\n#include "controls/fileview/FileView.h"\n',
        "hosts/headless/A.cpp": '#include "controls/link/Link.h"\n#include "controls/All.h"\n#include <unistd.h>\n',
        "hosts/qt/A.cpp": '#include "hosts/posix/Posix.h"\n#include <QWidget>\n',
        "hosts/qt/designer/A.cpp": '#include "hosts/qt/Qt.h"\n',
        "tools/tool/main.cpp": '#include "hosts/headless/Headless.h"\n#include "hosts/posix/Posix.h"\n',
    }, None),
    ("an include in a comment", in_frame('// #include "hosts/qt/Qt.h"\n/*\n#include <QWidget>\n*/\n'), None),
    ("frame includes a child", including("frame/A.cpp", '"frame/child/Child.h"'), "frame must not include frame/child/Child.h"),
    ("frame goes up by two dots", including("frame/A.cpp", '"../hosts/qt/Qt.h"'), "frame must not include hosts/qt/Qt.h"),
    ("frame goes up in angle brackets", including("frame/A.cpp", "<hosts/qt/Qt.h>"), "frame must not include hosts/qt/Qt.h"),
    ("a child includes the file services", including("frame/child/A.cpp", '"fileservices/Files.h"'), "frame/child must not"),
    ("the file services include a control", including("fileservices/A.cpp", '"controls/link/Link.h"'), "fileservices must not"),
    ("a control includes another", including("controls/tutor/A.cpp", '"controls/link/Link.h"'), "controls/tutor must not"),
    ("Link includes the file services", including("controls/link/A.cpp", '"fileservices/Files.h"'), "controls/link must not"),
    ("a control includes the list of all", including("controls/link/A.cpp", '"controls/All.h"'), "controls/link must not"),
    ("a control includes a host", including("controls/link/A.cpp", '"hosts/headless/Headless.h"'), "controls/link must not"),
    ("headless includes posix", including("hosts/headless/A.cpp", '"hosts/posix/Posix.h"'), "hosts/headless must not"),
    ("headless includes qt", including("hosts/headless/A.cpp", '"hosts/qt/Qt.h"'), "hosts/headless must not"),
    ("posix includes headless", including("hosts/posix/A.cpp", '"hosts/headless/Headless.h"'), "hosts/posix must not"),
    ("a host includes a tool", {"tools/tool/T.h": "#pragma once\n", **including("hosts/qt/A.cpp", '"tools/tool/T.h"')}, "hosts/qt must not"),
    ("a library includes a test's file", {"tests/T.h": "", **including("frame/A.cpp", '"tests/T.h"')}, "frame must not include tests/T.h"),
    *((f"{header} in {folder}", including(f"{folder}/A.cpp", header), "neither of the standard library")
      for folder in ("frame", "frame/child", "fileservices", "controls/link")
      for header in ("<QString>", '"windows.h"', "<unistd.h>", "<sys/stat.h>", "<fcntl.h>", "<dirent.h>", "<pthread.h>", "NAME")),
    ("constants and functions", in_frame("""
        #define COUNTER \\
            static int counter
        namespace a {
        inline constexpr int limit = 16'384, wide = 2;
        const char* const name = "static int x;";
        template <class T> constexpr bool isText = false;
        template <> inline constexpr const B* tableOf<A<B, C>> = &table;
        template <class T> concept Number = requires(T t) { t + t; };
        enum class Kind : int { One, Two };
        bool operator==(const A&, const A&) = default;
        static int Helper(int x) { return x < 0 ? -x : x; }
        std::string Name(int number);
        struct A final : B { int field = 0; static A Make(int x); static constexpr int most = 3; };
        A::A(int x) : B(x), first{1}, second{2} { for (int i = 0; i < 3; ++i) { Use(i); } }
        void f() {
            static const std::array<int*, 2> table = {nullptr, nullptr};
            static const auto& first = table[0];
            static_assert(sizeof(A) == 4);
            call([&] { int x = static_cast<int>('{'); });
        }
        }  // namespace a
        """), None),
    *((f"the mutable static {code}", in_frame(code), "frame/A.cpp:2: state that every host would share")
      for code in ("\nint counter = 0;", "\nnamespace { std::vector<int> found; }", "\ninline std::string text{};", "\nstatic const char* name = 0;",
                   "\nthread_local int depth = 0;", "\nstruct A { static int count; };", "\nclass A { public:\nstatic inline A* only = 0; };",
                   "\nint f() { static int calls; return ++calls; }", "\nA& g() { static A only(1, 2); return only; }",
                   "\nvoid h() { call([] { static std::map<int, const int> cache; }); }", "\nauto f = 1;")),
    ("a header without a guard", {"frame/A.h": "#include <vector>\n"}, "a header begins with #pragma once"),
    ("a header of a host without a guard", {"hosts/qt/A.h": "// words\n#pragma once\n"}, "a header begins with #pragma once"),
]


def self_test():
    failures = 0
    for name, files, expected in TREES:
        with tempfile.TemporaryDirectory() as folder:
            for path, text in {**BASE, **files}.items():
                file = pathlib.Path(folder) / path
                file.parent.mkdir(parents=True, exist_ok=True)
                file.write_text(text, encoding="utf-8")
            found = list(offences(folder))
        right = not found if expected is None else len(found) == 1 and expected in found[0]
        if not right:
            failures += 1
            print(f"FAILED: {name}: expected {expected or 'nothing'}, found {found}")
    print(f"{len(TREES) - failures} passed, {failures} failed")
    return failures


def main():
    if sys.argv[1:] == ["--self-test"]:
        return 1 if self_test() else 0
    root = pathlib.Path(sys.argv[1] if len(sys.argv) > 1 else pathlib.Path(__file__).parents[2])
    if not (root / "frame").is_dir():
        print(f"{root} is not the project's folder: it has no frame/")
        return 1
    found = list(offences(root))
    print("\n".join(found) or "Every include goes down, the neutral folders are neutral, every header is guarded.")
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
