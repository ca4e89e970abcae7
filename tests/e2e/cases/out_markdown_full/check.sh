# Every finding is in the export, past the size of a comment.
[ "$(wc -c < findings.md)" -gt 65536 ] &&
  [ "$(grep -c '^| `MHBDM` | .* | new |$' findings.md)" = 800 ] &&
  [ "$(grep -c '^| `MHBDM` | .* | accepted: Agreed |$' findings.md)" = 200 ] &&
  ! grep -q 'left out' findings.md
