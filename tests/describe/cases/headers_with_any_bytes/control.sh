# A header whose name holds a control character.
printf 'struct Tab {\n  void Go();\n};\n' > "pub/tab$(printf '\001').h"
exec -a zor2describe "$ZOR2DESCRIBE" -framework Menu -public pub -o out.xml
