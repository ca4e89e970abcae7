#!/usr/bin/env python3
"""Renders the Markdown exports that export_example wrote as GitHub does
(cmark-gfm with its table and autolink extensions, raw HTML let through so that
a value that escaped its escaping would show) and checks what a reader of the
rendered page gets: the headings and table cells hold the names and values
exactly as the documents wrote them, no markup and no link comes from them,
and a page stays under the size of a comment unless asked otherwise.

Usage: markdown_render.py EXPORTS_DIR
"""
import html.parser
import os
import shutil
import subprocess
import sys

# The elements the export itself produces.
OWN_TAGS = {"h2", "h3", "h4", "h5", "p", "ul", "li", "strong", "em", "table", "thead", "tbody",
            "tr", "th", "td", "code", "br"}
COMMENT_CAP = 65536


class Rendered(html.parser.HTMLParser):
    """The headings, the table rows (cells as text, "<br>" as a line feed) and
    every tag of a rendered page."""

    def __init__(self):
        super().__init__(convert_charrefs=True)
        self.tags = set()
        self.headings = []
        self.rows = []
        self._text = None
        self._row = None
        self._paragraph = None
        self.last_text = ""

    def handle_starttag(self, tag, attrs):
        self.tags.add(tag)
        if tag in ("h2", "h3", "h4", "h5", "td", "th"):
            self._text = ""
        elif tag == "tr":
            self._row = []
        elif tag == "br" and self._text is not None:
            self._text += "\n"
        elif tag == "p":
            self._paragraph = ""

    def handle_endtag(self, tag):
        if tag in ("h2", "h3", "h4", "h5"):
            self.headings.append(self._text)
            self._text = None
        elif tag in ("td", "th"):
            self._row.append(self._text)
            self._text = None
        elif tag == "tr":
            self.rows.append(self._row)
        elif tag == "p":
            self.last_text = self._paragraph
            self._paragraph = None

    def handle_data(self, data):
        if self._text is not None:
            self._text += data
        if self._paragraph is not None:
            self._paragraph += data


def render(path):
    output = subprocess.run(["cmark-gfm", "--extension", "table", "--extension", "autolink",
                             "--unsafe", path],
                            check=True, capture_output=True).stdout.decode("utf-8")
    page = Rendered()
    page.feed(output)
    page.close()
    return page


def main():
    if len(sys.argv) != 2:
        sys.exit(__doc__)
    if shutil.which("cmark-gfm") is None:
        sys.exit("markdown_render: cmark-gfm is missing; scripts/setup.sh installs it "
                 "(Debian package cmark-gfm)")
    directory = sys.argv[1]
    failures = 0

    def expect(what, actual, expected):
        nonlocal failures
        if actual == expected:
            print(f"ok: {what}")
        else:
            failures += 1
            print(f"FAILED: {what}:\n  got      {actual!r}\n  expected {expected!r}")

    example = render(os.path.join(directory, "example.md"))
    expect("example: the verdict heads the page", example.headings[0],
           "zor2check: FAILED: 11 new findings (2 accepted by the baseline)")
    expect("example: counts in the message-type table's order",
           [row[0] for row in example.rows[1:15]],
           ["FHBD", "LHC", "UHC", "CHBD", "MHBDM", "NPVM", "ADVHC", "MRTHC", "INDM", "CINMA",
            "PMHC", "MOHBC", "ARVHC", ""])
    expect("example: full names keep their @", example.rows[2][1], "@ZOR2Level Has Changed")
    expect("example: new findings, then accepted ones, grouped by framework and file",
           example.headings[1:],
           ["11 new findings", "Framework DocumentModel", "Public: DocDocument.h",
            "Public: DocProperties.h", "Public: DocHistory.h", "Framework Geometry",
            "Public: GeoPoint.h", "Public: GeoCurve.h", "Protected: GeoMesh.h",
            "2 accepted findings", "Framework DocumentModel", "Public: DocDocument.h",
            "Framework Geometry", "Public: GeoLegacy.h"])
    expect("example: reference and checked values side by side",
           [row for row in example.rows if row[0] == "MRTHC" and len(row) == 6],
           [["MRTHC", "GeoPoint", "double Distance(const GeoPoint& iOther) const", "double",
             "float", "new"]])
    expect("example: only the export's own markup", example.tags - OWN_TAGS, set())

    hostile = render(os.path.join(directory, "hostile.md"))
    finding_rows = {row[0]: row for row in hostile.rows if len(row) == 6 and row[0] != "Code"}
    expect("hostile: values with markup, pipes and backticks are cells as written",
           finding_rows.get("MRTHC"),
           ["MRTHC", "K`lass`", 'std::map<int, T*> Get(const char* s = "</script>") const',
            "<script>alert('ref')</script>",
            "**bold** _it_ [link](javascript:alert(1)) @team $x$ |x|", "new"])
    expect("hostile: several values keep their lines, the reason stays text",
           finding_rows.get("MHBDM"),
           ["MHBDM", "K`lass`", "void Run(int ``a``)", "void Run(int ``a``)",
            "void Run(long a)\nvoid Run(short a)",
            "accepted: Accepted <em>on purpose</em> | see #12 & @lead"])
    expect("hostile: control characters and quotes survive",
           finding_rows.get("ADVHC"),
           ["ADVHC", "C", "void Set(int a = 1), Arg_1", "1", "\x01\t\"\\\n'", "new"])
    expect("hostile: names with markup are heading text",
           hostile.headings[2:6],
           ['Framework <b>Bold</b> & "Co"', "Public: a|b <c>.h",
            "Framework Fr\u00e9d\u00e9ric \ufffd\ufffd", "Protected: Gr\u00f6\u00dfe.h"])
    expect("hostile: paths and options in the run table",
           [row[1] for row in hostile.rows if row and row[0] in ("Reference", "Options")],
           ["ref dir/<i>a</i>|b", "-level M4R20 | rm -rf"])
    expect("hostile: only the export's own markup", hostile.tags - OWN_TAGS, set())

    links = render(os.path.join(directory, "links.md"))
    expect("links: no link from URLs, www. names or e-mail addresses", links.tags - OWN_TAGS,
           set())
    link_rows = {row[0]: row for row in links.rows if len(row) == 7 and row[0] != "Code"}
    expect("links: a lone carriage return breaks a line, not the row",
           link_rows.get("CINMA"),
           ["CINMA", "user@host.com", "", "https://ref.example",
            "a\n[x](http://c.example) www.d.com e@f.com",
            "accepted: mail user@host.com or see https://x.example and www.z.com", ""])
    expect("links: blank values say what they are", link_rows.get("ADVHC")[3:5],
           ["blank: 3 spaces", "blank: 1 tab"])
    expect("links: a declaration's line shows as file:line",
           [link_rows.get("MRTHC")[6], link_rows.get("MHBDM")[6]],
           ["geo/Point.h:42", "geo/Point.h:7"])
    expect("links: likely replacements left out are counted", link_rows.get("MHBDM")[4],
           "void Move(long dx)\nand 5 more")
    expect("links: URL-like names are heading text",
           [heading for heading in links.headings if "evil" in heading],
           ["Framework https://evil.example/fw", "Public: www.evil.com/a.h",
            "Framework https://evil.example/fw", "Public: www.evil.com/a.h"])
    expect("links: the verdict says the run failed", links.headings[0].split(":")[1].strip(),
           "ERROR")

    with open(os.path.join(directory, "many.md"), "rb") as stream:
        size = len(stream.read())
    many = render(os.path.join(directory, "many.md"))
    shown = [row[5] for row in many.rows if len(row) == 6 and row[0] == "MRTHC"]
    expect("many: the page fits a comment", size <= COMMENT_CAP, True)
    expect("many: new findings come first", shown == sorted(shown, key=lambda s: s != "new"),
           True)
    expect("many: the last line counts what is left out",
           many.last_text.startswith(f"{2500 - len(shown)} more findings "), True)
    full = render(os.path.join(directory, "many-full.md"))
    expect("many-full: every finding with -markdown-full",
           len([row for row in full.rows if len(row) == 6 and row[0] == "MRTHC"]), 2500)

    print(f"{failures} failed" if failures else "all Markdown checks passed")
    return 1 if failures else 0


if __name__ == "__main__":
    sys.exit(main())
