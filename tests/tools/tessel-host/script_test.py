"""Drives the built program as a script does: script_test.py PROGRAM, or
script_test.py EMULATOR... PROGRAM. Exit code 1 when a claim does not hold."""
import json
import os
import re
import subprocess
import sys
import tempfile
import time
import traceback

PROGRAM = sys.argv[1:]
MANUAL = os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "..", "..", "docs", "tessel-host.md")
MEBIBYTE = 1 << 20
LINK = '{"do":"create","class":"Link","name":"Link1","mode":"run","bag":{"Caption":"Docs","LinkTo":"a.txt"}}'
CLICK = '{"do":"fire","of":"Link1.Label1","event":"Click"}'


def run(data, *arguments, seconds=60):
    """The exit code, the output and the error output of one run on `data`."""
    if isinstance(data, str):
        data = data.encode()
    done = subprocess.run([*PROGRAM, *arguments], input=data, stdout=subprocess.PIPE, stderr=subprocess.PIPE, timeout=seconds)
    return done.returncode, done.stdout, done.stderr


def replies(*lines):
    """The replies to lines, each without its end. The run must succeed and answer every line."""
    code, output, errors = run("\n".join(lines) + "\n")
    assert code == 0 and errors == b"", (code, errors)
    given = output.decode().split("\n")
    assert given[-1] == "" and len(given) - 1 == len(lines), given
    return given[:-1]


def last(*lines):
    return json.loads(replies(*lines)[-1])


def holds_replies(*pairs):
    """Each request, and the reply that it must have byte for byte."""
    for (request, wanted), given in zip(pairs, replies(*[request for request, _ in pairs])):
        assert given == wanted, f"\n  request {request}\n  wanted  {wanted}\n  given   {given}"


def test_replies_have_the_value_or_the_error_first_and_then_the_log():
    holds_replies(
        (LINK, '{"value":"Link1","log":[]}'),
        ('{"do":"fire","of":"Link1.Label1","event":"MouseDown","args":[1,0,300,100]}',
         '{"value":null,"log":[["event","Link1","MouseDown",[1,0,300.0,100.0]],["execute","open","a.txt"]]}'),
        ('{"do":"put","of":"Link1","name":"BorderSize","value":"x"}',
         '{"error":{"number":13,"description":"Type mismatch"},"log":[]}'),
        ('{"do":"get","of":"Link1","name":"backcolor"}', '{"value":2147483663,"log":[]}'),
        ('{"do":"put","of":"Link1","name":"BorderSize","value":0.1}', '{"value":null,"log":[["changed","Link1","BorderSize"]]}'),
        ('{"do":"get","of":"Link1","name":"BorderSize"}', '{"value":0.1,"log":[]}'),
        ('{"do":"get","of":"Link1","name":-518}', '{"value":"Docs","log":[]}'),
        ('{"do":"get","of":"Link1","name":"Font"}',
         '{"value":{"Name":"MS Sans Serif","Size":8.25,"Bold":false,"Italic":false,"Underline":false,"Strikethrough":false,'
         '"Weight":400,"Charset":0},"log":[]}'),
    )


def test_the_examples_of_the_manual_are_one_session_and_reply_as_printed():
    with open(MANUAL, encoding="utf-8") as manual:
        lines = "".join(re.findall(r"^```json\n(.*?)^```$", manual.read(), re.MULTILINE | re.DOTALL)).splitlines()
    assert len(lines) > 50 and len(lines) % 2 == 0, len(lines)
    holds_replies(*zip(lines[::2], lines[1::2]))


def test_a_form_with_siblings_and_a_control_is_made_changed_and_taken_down():
    holds_replies(
        ('{"do":"form","name":"Form2","ScaleWidth":3000,"Caption":"Test"}', '{"value":"Form2","log":[]}'),
        ('{"do":"sibling","name":"Text1","index":0,"props":{"Text":"a"}}', '{"value":"Text1(0)","log":[]}'),
        ('{"do":"sibling","name":"Box","surface":true}', '{"value":"Box","log":[]}'),
        (LINK, '{"value":"Link1","log":[]}'),
        ('{"do":"get","of":"Form2","name":"ScaleWidth"}', '{"value":3000.0,"log":[]}'),
        ('{"do":"get","of":"Text1(0)","name":"Text"}', '{"value":"a","log":[]}'),
        ('{"do":"call","of":"Box","name":"Line","args":[0,0,15,30,255,"BF"]}',
         '{"value":null,"log":[["draw","Box","Line",0.0,0.0,15.0,30.0,255,"BF"]]}'),
        ('{"do":"resize","of":"Link1","width":900,"height":300}', '{"value":null,"log":[]}'),
        ('{"do":"get","of":"Link1.Label1","name":"Width"}', '{"value":900.0,"log":[]}'),
        ('{"do":"hide","of":"Link1"}', '{"value":null,"log":[]}'),
        ('{"do":"get","of":"Link1","name":"Visible"}', '{"value":false,"log":[]}'),
        ('{"do":"show","of":"Link1"}', '{"value":null,"log":[]}'),
        ('{"do":"paint","of":"Link1"}', '{"value":null,"log":[]}'),
        ('{"do":"ambient","of":"Link1","name":"UserMode","value":false}', '{"value":null,"log":[]}'),
        ('{"do":"destroy","of":"Link1"}', '{"value":null,"log":[]}'),
        ('{"do":"get","of":"Link1","name":"Caption"}',
         '{"error":{"number":424,"description":"There is no object \\"Link1\\""},"log":[]}'),
        ('{"do":"destroy","of":"Text1(0)"}', '{"value":null,"log":[]}'),
    )


def test_a_save_loads_again_as_the_same_control():
    put = '{"do":"put","of":"Link1","name":"Font","value":{"Name":"Courier New","Size":12,"Bold":true}}'
    bag = last(LINK, put, '{"do":"save","of":"Link1"}')["value"]["bag"]
    assert list(bag) == ["Font", "Caption", "LinkTo"], bag
    again = json.dumps({"do": "create", "class": "Link", "name": "Link2", "bag": bag})
    assert last(again, '{"do":"save","of":"Link2"}')["value"]["bag"] == bag


def test_handlers_set_compare_count_and_run():
    handler = {"do": "handler", "of": "Link1", "event": "MouseUp", "when": {"Button": 1}, "times": 1, "set": {"Shift": 1},
               "run": [{"do": "get", "of": "Link1", "name": "Caption"}]}
    up = '{"do":"fire","of":"Link1.Label1","event":"MouseUp","args":[%d,0,1,1]}'
    holds_replies(
        (LINK, '{"value":"Link1","log":[]}'),
        (json.dumps(handler), '{"value":null,"log":[]}'),
        (up % 2, '{"value":null,"log":[["event","Link1","MouseUp",[2,0,1.0,1.0]]]}'),
        (up % 1, '{"value":null,"log":[["event","Link1","MouseUp",[1,0,1.0,1.0]],["reply",{"value":"Docs"}]]}'),
        (up % 1, '{"value":null,"log":[["event","Link1","MouseUp",[1,0,1.0,1.0]]]}'),
    )


def test_an_error_inside_an_event_reaches_the_reply():
    reply = last(LINK, '{"do":"handler","of":"Link1","event":"Click","set":{"Nothing":1}}', CLICK)
    assert reply == {"error": {"number": 438, "description": 'The event has no argument "Nothing"'},
                     "log": [["event", "Link1", "Click", []]]}, reply


def test_endless_recursion_of_handlers_ends():
    handler = '{"do":"handler","of":"Link1","event":"Click","run":[%s]}'
    assert "value" in last(LINK, handler % CLICK, CLICK)
    reply = last(LINK, handler % (CLICK + "," + CLICK), CLICK)
    assert reply["error"]["description"] == "One line sets off too many requests", reply["error"]


def test_the_shell_answers_from_its_queue_and_message_boxes_are_logged():
    call = '{"do":"call","of":"Link1","name":"PrintLink","args":["t.txt"]}'
    holds_replies(
        (LINK, '{"value":"Link1","log":[]}'),
        ('{"do":"shell","execute":[31],"operation":[{"return":0,"aborted":true,"error":5}]}', '{"value":null,"log":[]}'),
        ('{"do":"answers","msgbox":[1],"dialog":[null],"popup":[null],"form":[]}', '{"value":null,"log":[]}'),
        (call, '{"value":"No application associated with file","log":[["execute","print","t.txt"],'
               '["msgbox","Error 31: No application associated with file \'t.txt\'",0,""]]}'),
        (call, '{"value":"","log":[["execute","print","t.txt"]]}'),
    )


def test_time_and_chance_are_set():
    holds_replies(
        ('{"do":"now","value":"2001-02-03 04:05:06"}', '{"value":null,"log":[]}'),
        ('{"do":"advance","ms":1000}', '{"value":null,"log":[]}'),
        ('{"do":"random","values":[0.25,0.5]}', '{"value":null,"log":[]}'),
        ('{"do":"advance","ms":-1}', '{"error":{"number":5,"description":"\\"ms\\" must be from 0 to 1e12 milliseconds"},"log":[]}'),
    )


def test_every_mistake_has_an_error_reply_and_the_session_goes_on():
    mistakes = [
        ('{"do":"dance"}', 5), ("nonsense", 5), ("[]", 5), ("7", 5), ("null", 5), ("{}", 5), ('{"do":7}', 5), ("{", 5),
        ('{"do":"get","of":"Link9","name":"Caption"}', 424),
        ('{"do":"get","of":"Link1","name":"Colour"}', 438),
        ('{"do":"get","of":"Link1"}', 5),
        ('{"do":"get","of":"Link1..x","name":"Caption"}', 5),
        ('{"do":"put","of":"Link1","name":"Name","value":"x"}', 382),
        ('{"do":"put","of":"Link1","name":"BorderSize","value":1e39}', 6),
        ('{"do":"put","of":"Link1","name":"BorderSize","value":1e999}', 5),
        ('{"do":"put","of":"Link1","name":"BorderSize","value":NaN}', 5),
        ('{"do":"put","of":"Link1","name":"Font","value":{"Nam":"x"}}', 13),
        ('{"do":"put","of":"Link1","name":"Font","value":{"picture":"C:\\\\p.bmp"}}', 53),
        ('{"do":"call","of":"Link1","name":"OpenLink","args":[1,2]}', 450),
        ('{"do":"fire","of":"Link1.Label1","event":"Sneeze"}', 438),
        ('{"do":"fire","of":"Link1.Label1","event":"MouseUp","args":[1]}', 449),
        ('{"do":"handler","of":"Link1","event":"Sneeze"}', 438),
        ('{"do":"create","class":"Chain","name":"x"}', 5),
        ('{"do":"create","class":"Link","name":"link1"}', 457),
        ('{"do":"create","class":"Link","name":"x","bag":{"BorderSize":"wide"}}', 13),
        ('{"do":"advance","ms":"soon"}', 13),
        ('{"do":"now","value":"soon"}', 13),
        ('{"do":"resize","of":"Form1","width":1,"height":1}', 424),
    ]
    lines = [LINK] + [line for line, _ in mistakes] + ['{"do":"get","of":"Link1","name":"Caption"}']
    given = [json.loads(reply) for reply in replies(*lines)]
    for (line, number), reply in zip(mistakes, given[1:]):
        assert list(reply) == ["error", "log"] and reply["error"]["number"] == number, (line, reply)
        assert reply["error"]["description"], line
    assert given[-1] == {"value": "Docs", "log": []}


def test_bytes_that_are_no_text_have_an_error_reply():
    code, output, _ = run(b'{"do":"\xff"}\n\xc3\n\0\n{"do":"\0"}\n{"do":"now","value":"2001-02-03"}\n')
    numbers = [json.loads(line).get("error", {}).get("number", 0) for line in output.splitlines()]
    assert code == 0 and numbers == [5, 5, 5, 5, 0], (code, numbers)


def test_bytes_of_a_name_that_are_no_utf_8_are_escaped():
    put = json.dumps({"do": "put", "of": "Link1", "name": "Caption", "value": "a\U0010FFE9"})
    assert last(LINK, put, '{"do":"get","of":"Link1","name":"Caption"}')["value"] == "a\U0010FFE9"


def test_empty_lines_have_no_reply_and_lines_end_with_or_without_a_carriage_return():
    code, output, _ = run(b'\n\r\n' + LINK.encode() + b'\r\n\n{"do":"get","of":"Link1","name":"Caption"}')
    assert (code, output) == (0, b'{"value":"Link1","log":[]}\n{"value":"Docs","log":[]}\n'), output


def test_a_line_beyond_the_limit_is_refused_in_seconds_and_the_next_is_read():
    start = time.monotonic()
    code, output, _ = run(b'{"do":"' + b"x" * (70 * MEBIBYTE) + b'"}\n' + LINK.encode() + b"\n")
    assert code == 0 and output == (b'{"error":{"number":5,"description":"The request is too long"},"log":[]}\n'
                                    b'{"value":"Link1","log":[]}\n'), output[:200]
    assert time.monotonic() - start < 30


def test_a_long_text_within_the_limit_is_kept():
    text = "x" * (8 * MEBIBYTE)
    put = json.dumps({"do": "put", "of": "Link1", "name": "LinkTo", "value": text})
    assert last(LINK, put, '{"do":"get","of":"Link1","name":"LinkTo"}')["value"] == text


def test_a_million_opening_brackets_are_refused():
    assert last("[" * 1_000_000)["error"]["description"] == "The request is nested too deep"
    assert last('{"a":' * 1_000_000)["error"]["description"] == "The request is nested too deep"


def test_a_million_fields_are_refused_in_seconds():
    start = time.monotonic()
    line = "{" + ",".join(f'"f{number}":1' for number in range(1_000_000)) + "}"
    assert last(line)["error"]["description"] == "An object has too many fields"
    assert time.monotonic() - start < 30


def test_a_file_is_read_in_place_of_the_input():
    with tempfile.TemporaryDirectory() as folder:
        path = os.path.join(folder, "report.jsonl")
        with open(path, "w") as file:
            file.write(LINK + "\n")
        assert run("{}", path) == (0, b'{"value":"Link1","log":[]}\n', b"")


def test_the_disk_is_chosen_on_the_command_line():
    listing = '{"do":"disk","list":"C:\\\\"}\n'
    for arguments in ([], ["--disk", "memory"]):
        assert json.loads(run(listing, *arguments)[1])["value"][0]["path"] == "C:\\Temp", arguments
    assert json.loads(run(listing, "--disk", "real")[1])["error"]["number"] == 5


def test_a_missing_file_and_a_wrong_command_line_end_with_code_2():
    with tempfile.TemporaryDirectory() as folder:
        for arguments in ([os.path.join(folder, "missing")], ["--unknown"], ["one", "two"], ["--disk"], ["--disk", "floppy"]):
            code, output, errors = run("", *arguments)
            assert code == 2 and output == b"" and errors, (arguments, code, output, errors)


def test_the_end_of_the_input_ends_the_program_with_code_0():
    assert run("") == (0, b"", b"")
    assert run("\n\n") == (0, b"", b"")


def test_each_reply_comes_before_the_next_request_is_read():
    with subprocess.Popen(PROGRAM, stdin=subprocess.PIPE, stdout=subprocess.PIPE, text=True) as program:
        for line in (LINK, CLICK):
            program.stdin.write(line + "\n")
            program.stdin.flush()
            assert "log" in json.loads(program.stdout.readline())
        program.stdin.close()
        assert program.wait(60) == 0


def main():
    tests = [(name, test) for name, test in sorted(globals().items()) if name.startswith("test_")]
    failed = 0
    for name, test in tests:
        try:
            test()
        except Exception:  # a claim that does not hold, or a program that hangs: said, and the next is tried
            failed += 1
            print(f"FAILED {name}\n{traceback.format_exc()}")
    print(f"{len(tests) - failed} of {len(tests)} hold")
    return 1 if failed else 0


if __name__ == "__main__":
    sys.exit(main())
