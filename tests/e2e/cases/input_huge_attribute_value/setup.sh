# A returned type of 10 MB whose last character differs between the documents.
document() {  # document <last character>
  printf '<Workspace><Framework Name="F"><Interfaces Name="Public"><File Name="K.h" Aut="Y">'
  printf '<Class Name="K" Aut="N"><Method Name="Foo" Access="Public" Signature="T Foo()" ReturnedType="'
  head -c 9999999 /dev/zero | tr '\0' 'T'
  printf '%s"/></Class></File></Interfaces></Framework></Workspace>\n' "$1"
}
document A > ref.xml
document B > chk.xml
