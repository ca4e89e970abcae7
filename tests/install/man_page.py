#!/usr/bin/env python3
"""Keeps a manual page in step with its program: man_page.py PROGRAM PAGE.

Every option that `PROGRAM -h` lists must be described in the page's OPTIONS section, and the
page may describe no option that -h does not list (but -h, --help, --version and the argument
file); the release in the page's title must be the one `--version` prints, every exit status
that -h names must be explained, and groff must render the page without a warning.
"""
import re
import subprocess
import sys

ALWAYS_DESCRIBED = {"-h", "--help", "--version"}


def section(page, name):
    match = re.search(r"^\.SH " + name + r"\n(.*?)(?=^\.SH |\Z)", page, re.M | re.S)
    if not match:
        sys.exit(f"the page has no {name} section")
    return match.group(1)


def tagged_entries(text):
    """The lines that follow each .TP: the tags of the entries."""
    return re.findall(r"^\.TP\n(.*)$", text, re.M)


def main():
    program, page_path = sys.argv[1:3]
    name = program.rsplit("/", 1)[-1]
    usage = subprocess.run([program, "-h"], capture_output=True, text=True, check=True).stdout
    version = subprocess.run([program, "--version"], capture_output=True, text=True,
                             check=True).stdout.strip()
    with open(page_path, encoding="utf-8") as f:
        page = f.read()
    problems = []

    listed = set(re.findall(r"^\s+(--?[A-Za-z][\w-]*)", usage, re.M))
    described = set()
    for tag in tagged_entries(section(page, "OPTIONS")):
        arguments = tag.split(None, 1)[1].replace("\\-", "-") if " " in tag else ""
        described.update(re.findall(r"(?<![\w-])(--?[A-Za-z][\w-]*)", arguments))
    for option in sorted(listed - described):
        problems.append(f"{name} -h lists {option}, which {page_path} does not describe "
                        "under OPTIONS: add it to the manual page")
    for option in sorted(described - listed - ALWAYS_DESCRIBED):
        problems.append(f"{page_path} describes {option}, which {name} -h does not list")

    title = re.search(r'^\.TH \S+ \d+ "[^"]*" "([^"]*)"', page, re.M)
    if not title or title.group(1) != version:
        problems.append(f"the page's title names {title.group(1) if title else 'no release'}, "
                        f"{name} --version says {version}")

    statuses = re.search(r"^Exit status :(.*?)(?=^\S|\Z)", usage, re.M | re.S)
    if statuses:
        explained = set()
        for tag in tagged_entries(section(page, "EXIT STATUS")):
            explained.update(re.findall(r"\d+", tag))
        for status in re.findall(r"(?<![\w-])(\d+) ", statuses.group(1)):
            if status not in explained:
                problems.append(f"{name} -h names exit status {status}, which {page_path} "
                                "does not explain under EXIT STATUS")

    render = subprocess.run(["groff", "-man", "-Tutf8", "-ww", "-z", page_path],
                            capture_output=True, text=True)
    if render.returncode != 0 or render.stderr:
        problems.append(f"groff does not render {page_path} cleanly:\n{render.stderr}")

    for problem in problems:
        print(problem)
    sys.exit(1 if problems else 0)


if __name__ == "__main__":
    main()
