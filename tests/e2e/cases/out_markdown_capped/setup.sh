# 1 000 methods deleted, with 200 of them accepted by the baseline: their
# Markdown export is longer than a comment holds.
awk 'BEGIN {
  print "<?xml version=\"1.0\" encoding=\"UTF-8\"?>"
  print "<Workspace><Framework Name=\"Big\"><Interfaces Name=\"Public\"><File Name=\"Big.h\" Aut=\"Y\"><Class Name=\"Big\">"
  for (i = 0; i < 1000; i++) {
    printf "<Method Name=\"Method%d\" Access=\"Public\" Signature=\"void Method%d(int a)\"><Arg Type=\"int\" Name=\"a\"/></Method>\n", i, i
  }
  print "</Class></File></Interfaces></Framework></Workspace>"
}' > ref.xml
printf '%s\n' '<Workspace><Framework Name="Big"><Interfaces Name="Public"><File Name="Big.h" Aut="Y"><Class Name="Big"/></File></Interfaces></Framework></Workspace>' > chk.xml
awk 'BEGIN {
  print "<XmlDiff><Framework Name=\"Big\"><Interfaces Name=\"Public\"><File Name=\"Big.h\"><Class Name=\"Big\">"
  for (i = 0; i < 1000; i += 5) {
    printf "<Method Name=\"Method%d\" Signature=\"void Method%d(int a)\"><Error ID=\"MHBDM\" Reason=\"Agreed\"/></Method>\n", i, i
  }
  print "</Class></File></Interfaces></Framework></XmlDiff>"
}' > baseline.xml
