# Two documents whose argument Arg holds 100 000 nested elements; the
# reference class has one method more than the checked one.
deep() {  # deep <methods>
  printf '<Workspace>\n<Framework Name="F">\n<Interfaces Name="Public">\n'
  printf '<File Name="K.h" Aut="Y">\n<Class Name="K" Aut="N">\n'
  printf '<Method Name="Foo" Access="Public" ReturnedType="void" Signature="void Foo(int i)">\n'
  printf '<Arg Type="int" Name="i">'
  yes '<Arg Type="long int">' | head -n 100000 | tr -d '\n'
  yes '</Arg>' | head -n 100000 | tr -d '\n'
  printf '</Arg>\n</Method>\n%s</Class>\n</File>\n</Interfaces>\n</Framework>\n</Workspace>\n' "$1"
}
deep '<Method Name="Bar" Access="Public" ReturnedType="int" Signature="int Bar()"/>
' > ref.xml
deep '' > chk.xml
