# 1500 classes deleted: a report of some 500 KB, more than a pipe holds.
{
  echo '<?xml version="1.0" encoding="UTF-8"?>'
  echo '<Workspace><Framework Name="F"><Interfaces Name="Public"><File Name="K.h" Aut="Y">'
  for i in $(seq 1500); do echo "<Class Name=\"K$i\" Aut=\"N\"/>"; done
  echo '</File></Interfaces></Framework></Workspace>'
} > ref.xml
{
  echo '<?xml version="1.0" encoding="UTF-8"?>'
  echo '<Workspace><Framework Name="F"><Interfaces Name="Public"><File Name="K.h" Aut="Y">'
  echo '</File></Interfaces></Framework></Workspace>'
} > chk.xml
