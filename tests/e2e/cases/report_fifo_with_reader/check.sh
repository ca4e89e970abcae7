# The reader got the whole report.
[ "$(head -n 1 got.xml)" = '<?xml version="1.0" encoding="UTF-8"?>' ] &&
  [ "$(grep -c 'ID="CHBD"' got.xml)" = 1500 ] && [ "$(tail -n 1 got.xml)" = '</XmlDiff>' ]
