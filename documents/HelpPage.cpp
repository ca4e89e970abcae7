#include "documents/HelpPage.h"

#include <cstring>

#include "platform/tools/ZOROFStream.h"
#include "rules/MessageTypes.h"

namespace {

void WriteEntry(ZOROFStream& page, const ZOR2ErrorType& type) {
  page << "<HR><TABLE>" << endl;
  // The page keeps its long-standing markup: the anchor is left open and its
  // name unquoted; links into the page use "#" and the code.
  page << "<TR><TD><B><A NAME=" << type.code << ">" << type.code << " : " << type.fullName
       << "</B></TD></TR>" << endl;
  page << "</TABLE>" << endl;
  page << "<TABLE CELLSPACING=10><TR><TD><FONT SIZE=-1>" << endl;
  page << type.help << endl;
  page << "</FONT></TD></TR></TABLE>" << endl;
}

}  // namespace

int WriteHelpFile(const char* path) {
  ZOROFStream page;
  page.open(path, 8);
  if (!page.isOpen()) {
    ZORerr << "Unable to open file " << path << endl;
    return 1;
  }
  page << "<HTML>" << endl;
  page << "<TITLE>Index of Messages Type</TITLE>" << endl;
  page << "<BR>" << endl;
  const MessageTypeRegistry& registry = MessageTypeRegistry::Get();
  for (int i = 0; i < registry.Count(); ++i) {
    if (const ZOR2ErrorType* type = registry.At(i)) WriteEntry(page, *type);
  }
  page << "</HTML>" << endl;
  if (page.close() == 0) return 0;
  ZORerr << "ERROR: " << path << ": " << std::strerror(page.error()) << endl;
  return 1;
}
