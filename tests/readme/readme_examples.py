#!/usr/bin/env python3
"""Runs every shell example of the README against an installed copy of the build.

A ``console`` block holds examples: a line starting with ``$ `` is a command, the lines below it up
to the next command are its output. The commands of one block run in one shell, in order, so
``cd`` and ``echo $?`` work as printed. A block fenced as ```<language> <file name>``` is written to
that file first, so a program shown in the README can be built by the commands below it.

Paths differ from machine to machine: the README shows them as on a machine with the Debian package
installed, so /usr/share/pigmo in a command means the scratch prefix's data folder, and in the output
the scratch prefix shows as /usr and the scratch home as /home/you.
Usage: readme_examples.py README PREFIX
"""
import os
import re
import subprocess
import sys
import tempfile

MARK = "@@readme-example-{}@@"


def parse(text):
    files, blocks = {}, []
    lines = text.split("\n")
    i = 0
    while i < len(lines):
        fence = re.match(r"^```(\S*)\s*(\S*)\s*$", lines[i])
        if not fence or not fence.group(1):
            i += 1
            continue
        language, name = fence.group(1), fence.group(2)
        body = []
        i += 1
        while i < len(lines) and not lines[i].startswith("```"):
            body.append(lines[i])
            i += 1
        i += 1
        if language == "console":
            examples = []
            for line in body:
                if line.startswith("$ "):
                    examples.append((line[2:], []))
                elif examples:
                    examples[-1][1].append(line)
            blocks.append(examples)
        elif name:
            files[name] = "\n".join(body) + "\n"
    return files, blocks


def main():
    readme, prefix = sys.argv[1], os.path.realpath(sys.argv[2])
    files, blocks = parse(open(readme, encoding="utf-8").read())
    count = sum(len(b) for b in blocks)
    if count == 0:
        sys.exit("no examples found in " + readme)
    failures = 0
    with tempfile.TemporaryDirectory() as scratch:
        home = os.path.join(scratch, "home")
        work = os.path.join(home, "work")
        os.makedirs(work)
        for name, content in files.items():
            with open(os.path.join(work, name), "w", encoding="utf-8") as f:
                f.write(content)
        env = {
            "PATH": os.path.join(prefix, "bin") + ":/usr/bin:/bin",
            "HOME": home,
            "LANG": "C.UTF-8",
            "PKG_CONFIG_PATH": os.path.join(prefix, "lib", "pkgconfig"),
            "PYTHONPATH": os.path.join(prefix, "lib", "python3", "dist-packages"),
        }
        for name in ("ASAN_OPTIONS", "UBSAN_OPTIONS", "LD_PRELOAD"):
            if name in os.environ:
                env[name] = os.environ[name]
        for examples in blocks:
            # The marker must not hide the last status from an "echo $?".
            script = "exec 2>&1\nstatus=0\n"
            for n, (command, _) in enumerate(examples):
                command = command.replace("/usr/share/pigmo", os.path.join(prefix, "share", "pigmo"))
                script += f"printf '%s\\n' '{MARK.format(n)}'\n(exit $status)\n{command}\nstatus=$?\n"
            run = subprocess.run(["bash", "-c", script], cwd=work, env=env, capture_output=True, text=True,
                                 errors="replace", timeout=600)
            output = run.stdout.replace(prefix, "/usr").replace(home, "/home/you")
            chunks = re.split(r"@@readme-example-\d+@@\n", output)[1:]
            for (command, expected), actual in zip(examples, chunks + [""] * len(examples)):
                want = "\n".join(expected).rstrip("\n")
                got = actual.rstrip("\n")
                if want != got:
                    failures += 1
                    print(f"$ {command}\n--- README\n{want}\n--- program\n{got}\n")
    print(f"{count - failures} of {count} README examples ran as printed")
    sys.exit(1 if failures else 0)


if __name__ == "__main__":
    main()
