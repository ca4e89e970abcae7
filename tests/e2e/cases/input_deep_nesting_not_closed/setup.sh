# 100 000 nested elements, one a line, none of them closed.
{
  printf '<Workspace>\n'
  yes '<Framework Name="F">' | head -n 100000
} > ref.xml
