echo old > target.xml && ln -s target.xml out.xml
