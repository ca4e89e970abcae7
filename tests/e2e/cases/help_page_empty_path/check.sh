# No help page: only the documents, the report and the case's own files.
[ "$(LC_ALL=C ls -A | grep -v '^expected\.\|^actual\.\|^args$\|^check\.sh$' | tr '\n' ' ')" = "chk.xml out.xml ref.xml " ]
