echo "old page" > help.htm
