# Bytes of no text encoding, NUL bytes included: an image header, and a "<"
# followed by control bytes.
printf '\x89PNG\r\n\x1a\n\x00\x00\x00\rIHDR\x00\x00\x01\x00\xff\xd8<\x00>' > ref.xml
printf '<\x00\x01\x02\x03\xff\xfe' > chk.xml
