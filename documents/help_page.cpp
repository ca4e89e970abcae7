#include "documents/help_page.h"

#include "rules/message_types.h"

namespace zor2 {

std::string HelpPageText() {
  std::string page = "<HTML>\n<TITLE>Index of Messages Type</TITLE>\n<BR>\n";
  for (const MessageType& type : kMessageTypes) {
    page += "<HR><TABLE>\n";
    // The page keeps its long-standing markup: the anchor is left open and its
    // name unquoted; links into the page use "#" and the code.
    page.append("<TR><TD><B><A NAME=").append(type.id).append(">").append(type.id);
    page.append(" : ").append(type.full_name).append("</B></TD></TR>\n");
    page += "</TABLE>\n";
    page += "<TABLE CELLSPACING=10><TR><TD><FONT SIZE=-1>\n";
    page.append(type.help).append("\n");
    page += "</FONT></TD></TR></TABLE>\n";
  }
  page += "</HTML>\n";
  return page;
}

}  // namespace zor2
