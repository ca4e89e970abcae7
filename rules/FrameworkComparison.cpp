#include "rules/FrameworkComparison.h"

int CompareFrameworks(const QEXVBTXMLNode*, const QEXVBTXMLNode*, QEXVBTXMLNode*&) { return 0; }
