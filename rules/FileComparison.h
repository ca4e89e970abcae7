#pragma once

#include "platform/xml/QEXVBTXMLNode.h"
#include "rules/ReportMirror.h"

// Compares the files of interface group `group` ("Public" or "Protected") of a
// pair of "Framework" elements. Mirrors an "Interfaces" element named `group`
// under `report` (a walk without a report mirrors and records nothing) and,
// under it, a "File" element for every reference file subject to checking.
// Reports deleted files (FHBD) and, with OnlyFlaggedFiles, level (LHC) and
// usage (UHC) changes, and compares the classes of every file pair. Returns 0.
int CompareInterfaceFiles(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                          ReportMirror& report, const char* group);

// True when the reference "File" element `file` has at least one "Class" child
// and every one was deprecated recently enough, against CurrentLevel, for the
// file to be exempt from the file rules.
bool RecentlyDeprecatedFile(const QEXVBTXMLNode& file);
