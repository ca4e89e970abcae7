# A link that leads nowhere and a directory stand under the names of two
# reference documents; git keeps neither.
ln -s nowhere.xml chk/Geometry.xml
mkdir chk/Legacy.xml
