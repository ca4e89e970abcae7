# Neither export was left behind, whole or in part.
[ ! -e findings.json ] && [ ! -e findings.html ] && ! ls -A | grep -q "^\.zor2check\."
