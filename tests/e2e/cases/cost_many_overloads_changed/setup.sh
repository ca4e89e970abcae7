# One class with 16 000 overloads of one method, half of them changed in the
# checked document: each of the 8 000 deleted ones has 16 000 checked methods
# of its name.
overloads() {
  awk -v changed="$1" 'BEGIN {
    print "<?xml version=\"1.0\" encoding=\"UTF-8\"?>"
    print "<Workspace><Framework Name=\"Big\"><Interfaces Name=\"Public\"><File Name=\"Big.h\" Aut=\"Y\"><Class Name=\"Big\">"
    for (i = 0; i < 16000; i++) {
      type = (changed && i % 2 == 1) ? "U" i : "T" i
      printf "<Method Name=\"Set\" Access=\"Public\" Signature=\"void Set(%s a)\"><Arg Type=\"%s\" Name=\"a\"/></Method>\n", type, type
    }
    print "</Class></File></Interfaces></Framework></Workspace>"
  }'
}
overloads 0 > ref.xml
overloads 1 > chk.xml
