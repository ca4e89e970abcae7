#pragma once

#include <string>

#include "platform/xml/QEXVBTXMLNode.h"

// Answers whether `element` must stay in the report: a childless element stays
// exactly when it is an "Error"; an element with children stays when at least
// one of them stays. Every child that must not stay is removed from its parent
// and discarded on the way, at every depth. `element` itself is never removed
// (its parent decides). Works without recursion, whatever the depth.
bool PruneReport(QEXVBTXMLNode* element);

// Finishes the report rooted at `root` and writes it to `path`: removes each
// direct child of the root that PruneReport does not keep (the root itself
// always stays), escapes every attribute value for XML, and writes the
// document. Returns 0, or non-zero with `error` holding the system's reason
// when the report cannot be written.
int FinishReport(QEXVBTXMLNode& root, const char* path, std::string& error);
