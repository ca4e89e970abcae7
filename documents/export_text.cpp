#include "documents/export_text.h"

#include <unordered_map>
#include <utility>

#include "platform/xml/xml_characters.h"

namespace zor2 {

namespace {

constexpr std::string_view kReplacementCharacter = "\xEF\xBF\xBD";

// Appends `text` to `out`: runs of ASCII characters for which `special` is
// false as they are, each ASCII character for which it is true through
// `escape(c)`, every other valid UTF-8 sequence as it is and U+FFFD for each
// byte that starts none. Runs are copied whole: escaping is on the way of
// every export and most text needs none.
template <typename Special, typename Escape>
void AppendEscapedUtf8(std::string_view text, std::string* out, Special special, Escape escape) {
  size_t run = 0;
  char32_t code_point;
  for (size_t i = 0; i < text.size();) {
    const auto byte = static_cast<unsigned char>(text[i]);
    if (byte < 0x80 && !special(text[i])) {
      ++i;
      continue;
    }
    out->append(text.substr(run, i - run));
    if (byte < 0x80) {
      escape(text[i]);
      ++i;
    } else if (const size_t length = xml::DecodeUtf8(text.substr(i), &code_point); length == 0) {
      out->append(kReplacementCharacter);
      ++i;
    } else {
      out->append(text.substr(i, length));
      i += length;
    }
    run = i;
  }
  out->append(text.substr(run));
}

}  // namespace

void AppendValidUtf8(std::string_view text, std::string* out) {
  AppendEscapedUtf8(
      text, out, [](char) { return false; }, [](char) {});
}

void AppendJsonString(std::string_view text, std::string* out) {
  static constexpr char kHex[] = "0123456789abcdef";
  out->push_back('"');
  AppendEscapedUtf8(
      text, out,
      [](char c) { return c == '"' || c == '\\' || static_cast<unsigned char>(c) < 0x20; },
      [out](char c) {
        switch (c) {
          case '"':
            out->append("\\\"");
            break;
          case '\\':
            out->append("\\\\");
            break;
          case '\n':
            out->append("\\n");
            break;
          case '\r':
            out->append("\\r");
            break;
          case '\t':
            out->append("\\t");
            break;
          default:
            out->append("\\u00");
            out->push_back(kHex[(c >> 4) & 0xF]);
            out->push_back(kHex[c & 0xF]);
        }
      });
  out->push_back('"');
}

void AppendHtmlEscaped(std::string_view text, std::string* out) {
  AppendEscapedUtf8(
      text, out, [](char c) { return c == '&' || c == '<' || c == '>' || c == '"' || c == '\''; },
      [out](char c) {
        switch (c) {
          case '&':
            out->append("&amp;");
            break;
          case '<':
            out->append("&lt;");
            break;
          case '>':
            out->append("&gt;");
            break;
          case '"':
            out->append("&quot;");
            break;
          default:
            out->append("&#39;");
        }
      });
}

std::string HelpAsText(std::string_view help) {
  static constexpr std::pair<std::string_view, std::string_view> kTags[] = {
      {"<BR>", "\n"}, {"<PRE>", "\n"}, {"</PRE>", ""}};
  std::string text;
  for (size_t i = 0; i < help.size();) {
    bool replaced = false;
    for (const auto& [tag, replacement] : kTags) {
      if (help.substr(i, tag.size()) == tag) {
        text.append(replacement);
        i += tag.size();
        replaced = true;
        break;
      }
    }
    if (!replaced) text.push_back(help[i++]);
  }
  while (!text.empty() && (text.back() == '\n' || text.back() == ' ')) text.pop_back();
  return text;
}

std::string CountOf(int count, std::string_view noun) {
  std::string text = std::to_string(count);
  text += ' ';
  text += noun;
  if (count != 1) text += 's';
  return text;
}

std::string VerdictLine(const RunSummary& summary) {
  const int total = TotalFindings(summary);
  const int fresh = total - summary.accepted;
  std::string accepted;
  if (summary.accepted > 0) {
    accepted = " (" + std::to_string(summary.accepted) + " accepted by the baseline)";
  }
  if (VerdictOf(summary) == Verdict::kError) {
    const size_t failures = summary.failures.size();
    std::string line = "ERROR: the check is incomplete: " +
                       (failures == 1 ? std::string("an input or output")
                                      : std::to_string(failures) + " inputs or outputs") +
                       " failed";
    if (fresh > 0) line += "; " + CountOf(fresh, "new finding") + " so far";
    return line;
  }
  if (summary.failed) {
    std::vector<std::string> causes;
    if (fresh > 0) causes.push_back(CountOf(fresh, "new finding"));
    int documents = 0;
    for (const Absence& absence : summary.missing_documents) documents += !absence.accepted;
    int frameworks = 0;
    for (const Absence& absence : summary.missing_frameworks) frameworks += !absence.accepted;
    if (documents > 0) {
      causes.push_back(CountOf(documents, "reference document") + " without counterpart");
    }
    if (frameworks > 0) {
      causes.push_back(CountOf(frameworks, "reference framework") + " without counterpart");
    }
    if (summary.nothing_checked) causes.push_back("nothing was checked");
    std::string line = "FAILED: ";
    for (size_t i = 0; i < causes.size(); ++i) line += (i == 0 ? "" : ", ") + causes[i];
    return line + accepted;
  }
  if (total == 0) return "PASSED: no finding";
  if (fresh == 0) return "PASSED: " + CountOf(total, "finding") + ", all accepted by the baseline";
  return "PASSED: " + CountOf(total, "finding") + accepted;
}

std::string ScopeLine(const RunSummary& summary) {
  std::string line = CountOf(TotalFindings(summary), "finding");
  line += " in " + CountOf(summary.files, "file") + " of " +
          CountOf(summary.frameworks, "framework") + "; ";
  line += CountOf(summary.pairs_compared, "document pair") + " compared, " +
          std::to_string(summary.pairs_skipped) + " skipped for an error.";
  return line;
}

namespace {

// "Reference documents without a checked counterpart, not compared: a.xml,
// b.xml (accepted: "Retired")."
std::string AbsencesNote(const std::vector<Absence>& absences, std::string_view what) {
  std::string note = "Reference ";
  note += what;
  note += " without a checked counterpart, not compared: ";
  for (size_t i = 0; i < absences.size(); ++i) {
    if (i > 0) note += ", ";
    note += absences[i].name;
    if (absences[i].accepted) {
      note +=
          absences[i].reason.empty() ? " (accepted)" : " (accepted: " + absences[i].reason + ")";
    }
  }
  return note + ".";
}

}  // namespace

std::vector<std::string> SummaryNotes(const RunSummary& summary) {
  std::vector<std::string> notes;
  for (const RunFailure& failure : summary.failures) {
    notes.push_back("Failed: " + failure.path + ": " + failure.reason);
  }
  if (summary.pairs_skipped > 0) {
    notes.push_back(CountOf(summary.pairs_skipped, "document pair") +
                    " could not be compared: an input could not be read or parsed, so findings "
                    "may be missing.");
  }
  if (summary.nothing_checked) {
    notes.push_back(summary.pairs_compared == 0
                        ? "Nothing was checked: no document pair was compared."
                        : "Nothing was checked: no reference file passed the file filter in any "
                          "document pair.");
  }
  if (!summary.missing_documents.empty()) {
    notes.push_back(AbsencesNote(summary.missing_documents, "documents"));
  }
  if (!summary.missing_frameworks.empty()) {
    notes.push_back(AbsencesNote(summary.missing_frameworks, "frameworks"));
  }
  if (summary.stale_baseline_entries > 0) {
    const int stale = summary.stale_baseline_entries;
    notes.push_back(std::to_string(stale) + (stale == 1 ? " baseline entry" : " baseline entries") +
                    " matched no finding of this run.");
  }
  return notes;
}

std::string PlaceInFile(const Finding& finding) {
  std::string place;
  auto add = [&place](std::string_view part) {
    if (part.empty()) return;
    if (!place.empty()) place += ", ";
    place += part;
  };
  if (!finding.class_name.empty()) add("class " + finding.class_name);
  add(finding.signature.empty() ? finding.method : finding.signature);
  add(finding.argument);
  return place;
}

std::vector<FrameworkFindings> GroupByFrameworkAndFile(
    const std::vector<const Finding*>& findings) {
  std::vector<FrameworkFindings> frameworks;
  std::unordered_map<std::string, size_t> framework_index;
  // Per framework, the index of each file, keyed by group and name.
  std::vector<std::unordered_map<std::string, size_t>> file_index;
  for (const Finding* finding : findings) {
    auto [framework_it, new_framework] =
        framework_index.try_emplace(finding->framework, frameworks.size());
    if (new_framework) {
      frameworks.push_back({finding->framework, {}});
      file_index.emplace_back();
    }
    FrameworkFindings& framework = frameworks[framework_it->second];
    std::string file_key = finding->group;
    file_key += '\0';
    file_key += finding->file;
    auto [file_it, new_file] =
        file_index[framework_it->second].try_emplace(file_key, framework.files.size());
    if (new_file) framework.files.push_back({finding->group, finding->file, {}});
    framework.files[file_it->second].findings.push_back(finding);
  }
  return frameworks;
}

std::vector<FrameworkFindings> GroupByFrameworkAndFile(const std::vector<Finding>& findings) {
  std::vector<const Finding*> all;
  all.reserve(findings.size());
  for (const Finding& finding : findings) all.push_back(&finding);
  return GroupByFrameworkAndFile(all);
}

}  // namespace zor2
