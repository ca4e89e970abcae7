# Twenty overloads of one method are deleted, and the checked class keeps one
# whose signature is 100 kB long: the likely replacement of each, which every
# export shows twenty times and the report does not hold.
cc -shared -fPIC -o memory_limit.so "$E2E_DIR/memory_limit.c" 2>/dev/null ||
  { echo "SKIPPED: no C compiler for the preloaded library"; exit 77; }
long_type=$(head -c 100000 /dev/zero | tr '\0' 'x')
{
  echo '<?xml version="1.0" encoding="UTF-8"?>'
  echo '<Workspace><Framework Name="Big"><Interfaces Name="Public"><File Name="Big.h" Aut="Y"><Class Name="Big">'
  for i in $(seq 20); do
    echo "<Method Name=\"Set\" Access=\"Public\" Signature=\"void Set(T$i a)\"><Arg Type=\"T$i\" Name=\"a\"/></Method>"
  done
  echo '</Class></File></Interfaces></Framework></Workspace>'
} > ref.xml
cat > chk.xml <<XML
<?xml version="1.0" encoding="UTF-8"?>
<Workspace><Framework Name="Big"><Interfaces Name="Public"><File Name="Big.h" Aut="Y">
<Class Name="Big"><Method Name="Set" Access="Public" Signature="void Set($long_type a)"><Arg Type="long_type" Name="a"/></Method></Class>
</File></Interfaces></Framework></Workspace>
XML
