# The checked class holds a method whose signature is 1 MB long: a likely
# replacement that the exports show, and the report does not hold.
cc -shared -fPIC -o memory_limit.so "$E2E_DIR/memory_limit.c" 2>/dev/null ||
  { echo "SKIPPED: no C compiler for the preloaded library"; exit 77; }
long_type=$(head -c 1000000 /dev/zero | tr '\0' 'x')
cat > chk.xml <<XML
<?xml version="1.0" encoding="UTF-8"?>
<Workspace><Framework Name="Big"><Interfaces Name="Public"><File Name="Big.h" Aut="Y">
<Class Name="Big"><Method Name="Set" Access="Public" Signature="void Set($long_type a)"><Arg Type="long_type" Name="a"/></Method></Class>
</File></Interfaces></Framework></Workspace>
XML
