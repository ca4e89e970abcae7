# A build whose compilation database holds the include directory, a definition and the standard
# the headers need; the paths in it are relative to the build's directory. Git keeps no empty
# directory, so the build's is made here.
mkdir -p build
cat > build/compile_commands.json <<JSON
[
  {"directory": "$PWD/build", "file": "../src/other/widget.cpp",
   "arguments": ["g++", "-O2", "-I../gen", "-DLIB_FEATURE=1", "-std=gnu++20", "-Wall", "-c", "../src/other/widget.cpp"]}
]
JSON
exec -a zor2describe "$ZOR2DESCRIBE" -framework F -public pub -p build -o out.xml
