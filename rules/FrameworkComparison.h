#pragma once

#include "platform/xml/QEXVBTXMLNode.h"

// Compares the frameworks of one document pair: pairs reference and checked
// "Framework" elements by name and, for each pair, compares the "Public" and
// then the "Protected" interface groups. Records the findings under `report`,
// each under the mirrors of the reference elements that lead to it
// (ReportMirror); with a null `report` nothing is mirrored or recorded, but
// the walk and its log lines still run. The framework pairs are compared on
// two threads when there are several, each reading the documents only; the
// report and the log lines come out in reference order all the same.
// Returns 0.
int CompareFrameworks(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                      QEXVBTXMLNode*& report);
