# The deleted file holds a class that was never deprecated: whatever the
# level, even one that a deprecation two releases back would reach, the file
# may not go.
for level in M4R0 M4R1 M4R2; do
  "$@" -level "$level" > /dev/null
  echo "$level: $(grep -c '<Error ID="FHBD"' out.xml) FHBD"
done
