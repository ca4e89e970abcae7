# A class with 100 000 attributes, its name last, that the checked file lacks.
{
  printf '<Workspace><Framework Name="F"><Interfaces Name="Public"><File Name="K.h" Aut="Y">\n<Class'
  printf ' a%d="v"' $(seq 100000)
  printf ' Name="K"/>\n<Class Name="L"/>\n</File></Interfaces></Framework></Workspace>\n'
} > ref.xml
printf '<Workspace><Framework Name="F"><Interfaces Name="Public"><File Name="K.h" Aut="Y">
<Class Name="L"/>
</File></Interfaces></Framework></Workspace>\n' > chk.xml
