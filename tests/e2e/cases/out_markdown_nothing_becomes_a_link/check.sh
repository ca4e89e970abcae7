# Rendered as hosting services render it (raw HTML let through), the export holds no link, and each
# finding stays one row of six cells that show the values as written.
cmark-gfm --extension table --extension autolink --unsafe findings.md | python3 -c '
import html.parser, sys
class Rows(html.parser.HTMLParser):
    rows, links, cell = [], 0, None
    def handle_starttag(self, tag, attrs):
        if tag == "a": self.links += 1
        if tag == "tr": self.rows.append([])
        if tag == "td": self.cell = ""
        if tag == "br" and self.cell is not None: self.cell += "\n"
    def handle_endtag(self, tag):
        if tag == "td": self.rows[-1].append(self.cell); self.cell = None
    def handle_data(self, data):
        if self.cell is not None: self.cell += data
page = Rows()
page.feed(sys.stdin.read())
findings = [row for row in page.rows if len(row) == 6 and row[0] in ("ADVHC", "MRTHC")]
assert page.links == 0, page.links
assert findings == [
    ["ADVHC", "user@host.com", "void Set(int a), Arg_1", "blank: 3 spaces", "1", "new"],
    ["MRTHC", "user@host.com", "int Get()", "int\n[x](http://c.example) www.d.com e@f.com", "long",
     "accepted: see https://x.example or www.y.com, or mail user@host.com"]], findings
'
