# The export grows with the findings: each deleted method shows ten likely
# replacements and counts the others.
python3 - <<'PY'
import json, sys
findings = json.load(open("findings.json"))["findings"]
assert len(findings) == 8000, len(findings)
for finding in findings:
    shown = finding["checked_value"].split("\n")
    assert len(shown) == 10 and finding["more_replacements"] == 15990, finding
    assert all(line.startswith("void Set(") for line in shown), finding
PY
