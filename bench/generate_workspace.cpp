// Generates a reference and a checked interface description workspace for benchmarking
// zor2check.
//
// The content is seeded and deterministic: the same options always give the same bytes, so that
// the digest of a report can be stored and compared across optimisations. About one element in a
// hundred is changed on the checked side, spread over the changes behind each of the thirteen
// findings; a few more changes (type spellings that normalise to the same name) lead to none.
//
//   generate_workspace --reference DIR --checked DIR [--seed N] [--size MB]
//                      [--layout single|directory]
//                      [--shape workspace|class|file|group|overloads]
//                      [--count N] [--change-rate R]
//
// Layout "single" writes DIR/Workspace.xml on each side; "directory" writes one document per
// framework, DIR/<framework>.xml. The shapes other than "workspace" write the inputs of the growth
// runs and ignore --size: one class of N methods, one file of N classes, one group of N files, one
// class of N overloads of one name that differ only in their argument's type.

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <deque>
#include <cstring>
#include <filesystem>
#include <random>
#include <string>
#include <string_view>
#include <unordered_set>
#include <utility>
#include <vector>

namespace {

using std::string_view_literals::operator""sv;

// ---------------------------------------------------------------------------------------------
// Options

enum class Layout { kSingle, kDirectory };
enum class Shape { kWorkspace, kClass, kFile, kGroup, kOverloads };

struct Options {
  uint64_t seed = 1;
  double megabytes = 100;  // per side, for the workspace shape
  Layout layout = Layout::kSingle;
  Shape shape = Shape::kWorkspace;
  long count = 10000;  // N of the growth shapes
  double change_rate = 0.01;
  std::string reference_dir;
  std::string checked_dir;
};

constexpr char kUsage[] =
    "usage: generate_workspace --reference DIR --checked DIR [--seed N] [--size MB]\n"
    "                          [--layout single|directory]\n"
    "                          [--shape workspace|class|file|group|overloads]\n"
    "                          [--count N] [--change-rate R]\n";

[[noreturn]] void UsageError(const char* message, const char* item) {
  std::fprintf(stderr, "generate_workspace: %s%s\n%s", message, item, kUsage);
  std::exit(2);
}

Options ParseOptions(int argc, char** argv) {
  Options options;
  for (int i = 1; i < argc; ++i) {
    std::string_view key = argv[i];
    if (i + 1 >= argc) UsageError("missing value after ", argv[i]);
    const char* value = argv[++i];
    if (key == "--reference") {
      options.reference_dir = value;
    } else if (key == "--checked") {
      options.checked_dir = value;
    } else if (key == "--seed") {
      options.seed = std::strtoull(value, nullptr, 10);
    } else if (key == "--size") {
      options.megabytes = std::strtod(value, nullptr);
    } else if (key == "--count") {
      options.count = std::strtol(value, nullptr, 10);
    } else if (key == "--change-rate") {
      options.change_rate = std::strtod(value, nullptr);
    } else if (key == "--layout" && (value == "single"sv || value == "directory"sv)) {
      options.layout = value == "single"sv ? Layout::kSingle : Layout::kDirectory;
    } else if (key == "--shape" && value == "workspace"sv) {
      options.shape = Shape::kWorkspace;
    } else if (key == "--shape" && value == "class"sv) {
      options.shape = Shape::kClass;
    } else if (key == "--shape" && value == "file"sv) {
      options.shape = Shape::kFile;
    } else if (key == "--shape" && value == "group"sv) {
      options.shape = Shape::kGroup;
    } else if (key == "--shape" && value == "overloads"sv) {
      options.shape = Shape::kOverloads;
    } else {
      UsageError("bad option or value: ", argv[i - 1]);
    }
  }
  if (options.reference_dir.empty() || options.checked_dir.empty()) {
    UsageError("--reference and --checked are required", "");
  }
  if (options.megabytes <= 0 || options.count <= 0) UsageError("size and count must be > 0", "");
  return options;
}

// ---------------------------------------------------------------------------------------------
// Random choices

// Deterministic on every platform: the engine's sequence is fixed by the standard, and the
// reductions below are plain arithmetic (the standard distributions may differ between
// libraries, which would change the documents and so the stored report digests).
class Random {
 public:
  explicit Random(uint64_t seed) : engine_(seed) {}

  // A number in [0, n); n > 0.
  size_t Below(size_t n) { return static_cast<size_t>(engine_() % n); }
  // A number in [low, high].
  long Between(long low, long high) { return low + static_cast<long>(Below(high - low + 1)); }
  // True with probability p.
  bool Chance(double p) { return static_cast<double>(engine_() >> 11) * 0x1p-53 < p; }

  template <typename T, size_t N>
  const T& Pick(const T (&items)[N]) {
    return items[Below(N)];
  }

  // An item of a table whose entries have a `weight` member, chosen in proportion to it.
  template <typename T, size_t N>
  const T& PickWeighted(const T (&items)[N]) {
    long total = 0;
    for (const T& item : items) total += item.weight;
    long ticket = Between(0, total - 1);
    for (const T& item : items) {
      if (ticket < item.weight) return item;
      ticket -= item.weight;
    }
    return items[N - 1];
  }

 private:
  std::mt19937_64 engine_;
};

// ---------------------------------------------------------------------------------------------
// Vocabulary. All prefixes and names are invented.

struct Word {
  std::string_view text;
  int weight;
};

// A type as a header spells it. Spellings with the same `normal` name are one type to the
// checker (its type-name normalisation makes them equal); an empty `normal` means the text itself.
// `kind` drives argument names and default values: i integer, f floating, b boolean, p pointer,
// s string, r input object by reference, o output.
struct TypeSpelling {
  std::string_view text;
  std::string_view normal;
  char kind;
  int weight;
};

constexpr TypeSpelling kArgTypes[] = {
    {"long", "long", 'i', 8},
    {"long int", "long", 'i', 1},
    {"signed long", "long", 'i', 1},
    {"unsigned long", "ulong", 'i', 4},
    {"unsigned long int", "ulong", 'i', 1},
    {"long long", "long64", 'i', 2},
    {"signed long long", "long64", 'i', 1},
    {"unsigned long long", "", 'i', 1},
    {"long double", "", 'f', 1},
    {"int", "", 'i', 8},
    {"unsigned int", "", 'i', 2},
    {"short", "", 'i', 1},
    {"double", "", 'f', 8},
    {"float", "", 'f', 1},
    {"const long &", "", 'i', 1},
    {"const char *", "", 's', 3},
    {"const OvnUnicodeString &", "", 's', 10},
    {"OvnBoolean", "", 'b', 4},
    {"const OvnMathPoint &", "", 'r', 3},
    {"const OvnMathVector &", "", 'r', 2},
    {"const OvnLISTV<OvnMathPoint> &", "", 'r', 1},
    {"const OvnListValOvnUnicodeString &", "", 'r', 1},
    {"OvnIUnknown *", "", 'p', 3},
    {"OvnMathTransformation *", "", 'p', 1},
    {"int &", "", 'o', 3},
    {"long &", "", 'o', 2},
    {"long *", "", 'o', 1},
    {"double &", "", 'o', 3},
    {"OvnBoolean &", "", 'o', 1},
    {"OvnUnicodeString &", "", 'o', 3},
    {"OvnIUnknown **", "", 'o', 2},
    {"OvnBaseUnknown_var &", "", 'o', 1},
    {"OvnSafeArrayVariant &", "", 'o', 1},
};

constexpr TypeSpelling kReturnedTypes[] = {
    {"HRESULT", "", 'i', 40},
    {"void", "", 'i', 5},
    {"int", "", 'i', 3},
    {"long", "long", 'i', 2},
    {"long int", "long", 'i', 1},
    {"unsigned long", "", 'i', 1},
    {"long long", "", 'i', 1},
    {"long double", "", 'f', 1},
    {"double", "", 'f', 2},
    {"OvnBoolean", "", 'b', 3},
    {"const OvnUnicodeString &", "", 's', 1},
    {"OvnUnicodeString", "", 's', 1},
    {"const char *", "", 's', 1},
    {"OvnIUnknown *", "", 'p', 1},
    {"OvnLISTV<OvnMathPoint> *", "", 'p', 1},
};

std::string_view NormalName(const TypeSpelling& type) {
  return type.normal.empty() ? type.text : type.normal;
}

constexpr std::string_view kIntegerValues[] = {"0", "1", "-1", "10"};
constexpr std::string_view kFloatingValues[] = {"0.0", "1.0", "1.e-6"};
constexpr std::string_view kBooleanValues[] = {"FALSE", "TRUE"};
constexpr std::string_view kPointerValues[] = {"NULL"};
constexpr std::string_view kStringValues[] = {"\"\"", "\"Default\"", "\"<none>\""};

constexpr std::string_view kPrefixes[] = {"Ovn", "Trq", "Lmx", "Kzy", "Vbr",
                                          "Qud", "Hxo", "Zel", "Wmp", "Jyr"};
constexpr std::string_view kDomains[] = {
    "Geometric", "Mechanical", "Part",      "Sketcher",   "Drafting",   "Assembly",
    "Mesh",      "Kinematics", "Visual",    "Knowledge",  "Product",    "Structure",
    "Surface",   "Wireframe",  "Tolerance", "Analysis",   "Material",   "Simulation",
    "Machining", "Routing",    "Harness",   "Composites", "Sheetmetal", "Inspection"};
constexpr std::string_view kFrameworkEndings[] = {
    "Interfaces", "Objects", "Modeler", "Base", "UI", "Services", "Topology", "Foundation"};
constexpr std::string_view kVerbs[] = {
    "Get",      "Set",      "Compute",   "Create", "Remove", "Add",      "Find",    "Is",
    "Has",      "Update",   "Build",     "Count",  "Init",   "Reset",    "Apply",   "Check",
    "List",     "Load",     "Save",      "Copy",   "Move",   "Insert",   "Extract", "Evaluate",
    "Convert",  "Project",  "Intersect", "Attach", "Detach", "Activate", "Query",   "Modify",
    "Validate", "Register", "Scan",      "Split",  "Merge",  "Sort",     "Display", "Hide"};
constexpr std::string_view kNouns[] = {
    "Name",           "Origin",   "Length",    "Area",      "Volume",    "Point",      "Vector",
    "Plane",          "Curve",    "Surface",   "Face",      "Edge",      "Vertex",     "Body",
    "Shell",          "Wire",     "Loop",      "Feature",   "Parameter", "Constraint", "Sketch",
    "Layer",          "Color",    "Material",  "Density",   "Mass",      "Axis",       "Direction",
    "Normal",         "Tangent",  "Radius",    "Angle",     "Distance",  "Tolerance",  "Matrix",
    "Transformation", "Product",  "Part",      "Assembly",  "Component", "Instance",   "Reference",
    "Link",           "Document", "Container", "Attribute", "Property",  "Value",      "Unit",
    "Range",          "Limit",    "Profile",   "Section",   "Pattern",   "Offset",     "Thickness",
    "Draft",          "Fillet",   "Chamfer",   "Hole",      "Pocket",    "Pad",        "Rib",
    "Groove",         "Mesh",     "Node",      "Element",   "Group",     "Set",        "Filter",
    "Selection",      "Owner",    "Parent",    "Child",     "Status",    "Mode",       "Kind",
    "Index",          "Label",    "Comment",   "Version",   "Support",   "Context",    "Manager"};
constexpr std::string_view kQualifiers[] = {"Count",    "List",    "Mode",    "Status", "At",
                                            "From",     "To",      "Ex",      "ByName", "ByIndex",
                                            "Internal", "Default", "Current", "Max",    "Min"};
constexpr std::string_view kClassSuffixes[] = {"",           "",         "",          "Impl",
                                               "Factory",    "Manager",  "Services",  "Editor",
                                               "Attributes", "Settings", "Extension", "Adaptor"};
constexpr std::string_view kClassDeprecations[] = {"M4R16", "M4R18", "M4R19"};
constexpr std::string_view kMethodDeprecations[] = {"M4R15", "M4R18", "M4R19"};

constexpr Word kAccesses[] = {{"Public", 82}, {"Protected", 10}, {"Private", 8}};
constexpr Word kMethodTypes[] = {
    {"PureVirtual", 35}, {"Virtual", 40}, {"NonVirtual", 15}, {"Static", 10}};
constexpr Word kUsages[] = {{"U1", 30}, {"U2", 25}, {"U3", 20}, {"U4", 10}, {"U5", 15}};
constexpr Word kLevels[] = {{"L1", 80}, {"L2", 15}, {"", 5}};

struct Range {
  long low, high;
  int weight;
};
constexpr Range kMethodsPerClass[] = {{0, 0, 2}, {1, 20, 68}, {21, 60, 25}, {61, 200, 5}};
constexpr Range kArgsPerMethod[] = {{0, 0, 25}, {1, 1, 35}, {2, 2, 20}, {3, 3, 12}, {4, 6, 8}};
constexpr Range kClassesPerFile[] = {{0, 0, 2}, {1, 1, 83}, {2, 2, 10}, {3, 5, 5}};

// ---------------------------------------------------------------------------------------------
// Model of one file, built for the reference side and copied and changed for the checked side.
// Enumerated values point to the static vocabulary above.

struct Arg {
  const TypeSpelling* type = nullptr;
  std::string name;
  std::string_view value;  // the default value; empty for none
  bool retval = false;
};

struct Method {
  std::string name;
  std::string_view access;
  const TypeSpelling* returned = nullptr;  // null: no returned type
  std::string_view type;
  char property = 0;  // 0: no "Property" attribute
  bool nodoc = false;
  std::string_view deprecated;
  std::vector<Arg> args;
  bool removed = false;
};

struct Class {
  std::string name;
  std::string_view aut;
  std::string_view deprecated;
  std::vector<Method> methods;
  bool removed = false;
};

struct File {
  std::string name;
  std::string_view aut;
  std::string_view level;  // empty: no "@ZOR2Level"
  std::string_view usage;  // empty: no "@ZOR2Usage"
  std::vector<Class> classes;
  bool removed = false;
};

bool IsCompared(const Method& method) {
  return !method.removed && (method.access == "Public" || method.access == "Protected");
}

// ---------------------------------------------------------------------------------------------
// Writing

void AppendEscaped(std::string& out, std::string_view text) {
  for (char c : text) {
    switch (c) {
      case '&':
        out += "&amp;";
        break;
      case '<':
        out += "&lt;";
        break;
      case '>':
        out += "&gt;";
        break;
      case '"':
        out += "&quot;";
        break;
      default:
        out += c;
    }
  }
}

void AppendAttribute(std::string& out, std::string_view name, std::string_view value) {
  out += ' ';
  out += name;
  out += "=\"";
  AppendEscaped(out, value);
  out += '"';
}

void AppendIndent(std::string& out, int depth) {
  out.append(2 * depth, ' ');
}

// The declaration as a header writes it, e.g. "virtual HRESULT GetName(long iIndex) = 0".
std::string Signature(const Method& method) {
  std::string text;
  if (method.type == "Virtual" || method.type == "PureVirtual") text += "virtual ";
  if (method.type == "Static") text += "static ";
  if (method.returned != nullptr) {
    text += method.returned->text;
    text += ' ';
  }
  text += method.name;
  text += '(';
  for (size_t k = 0; k < method.args.size(); ++k) {
    const Arg& arg = method.args[k];
    if (k > 0) text += ", ";
    text += arg.type->text;
    text += ' ';
    text += arg.name;
    if (!arg.value.empty()) {
      text += " = ";
      text += arg.value;
    }
  }
  text += ')';
  if (method.type == "PureVirtual") text += " = 0";
  return text;
}

void WriteArg(std::string& out, const Arg& arg) {
  AppendIndent(out, 6);
  out += "<Arg";
  AppendAttribute(out, "Type", arg.type->text);
  AppendAttribute(out, "Name", arg.name);
  if (!arg.value.empty()) AppendAttribute(out, "Value", arg.value);
  if (arg.retval) AppendAttribute(out, "Retval", "Y");
  out += "/>\n";
}

void WriteMethod(std::string& out, const Method& method) {
  AppendIndent(out, 5);
  out += "<Method";
  AppendAttribute(out, "Name", method.name);
  AppendAttribute(out, "Access", method.access);
  if (method.returned != nullptr) AppendAttribute(out, "ReturnedType", method.returned->text);
  AppendAttribute(out, "Signature", Signature(method));
  AppendAttribute(out, "Type", method.type);
  if (method.property != 0) AppendAttribute(out, "Property", std::string_view(&method.property, 1));
  if (method.nodoc) AppendAttribute(out, "@nodoc", "Y");
  if (!method.deprecated.empty()) AppendAttribute(out, "Deprecated", method.deprecated);
  if (method.args.empty()) {
    out += "/>\n";
    return;
  }
  out += ">\n";
  for (const Arg& arg : method.args) WriteArg(out, arg);
  AppendIndent(out, 5);
  out += "</Method>\n";
}

void WriteClass(std::string& out, const Class& klass) {
  AppendIndent(out, 4);
  out += "<Class";
  AppendAttribute(out, "Name", klass.name);
  AppendAttribute(out, "Aut", klass.aut);
  if (!klass.deprecated.empty()) AppendAttribute(out, "Deprecated", klass.deprecated);
  if (klass.methods.empty()) {
    out += "/>\n";
    return;
  }
  out += ">\n";
  for (const Method& method : klass.methods) {
    if (!method.removed) WriteMethod(out, method);
  }
  AppendIndent(out, 4);
  out += "</Class>\n";
}

void WriteFile(std::string& out, const File& file) {
  AppendIndent(out, 3);
  out += "<File";
  AppendAttribute(out, "Name", file.name);
  AppendAttribute(out, "Aut", file.aut);
  if (!file.level.empty()) AppendAttribute(out, "@ZOR2Level", file.level);
  if (!file.usage.empty()) AppendAttribute(out, "@ZOR2Usage", file.usage);
  if (file.classes.empty()) {
    out += "/>\n";
    return;
  }
  out += ">\n";
  for (const Class& klass : file.classes) {
    if (!klass.removed) WriteClass(out, klass);
  }
  AppendIndent(out, 3);
  out += "</File>\n";
}

// One side's output: the document being written, through a buffer.
class SideWriter {
 public:
  explicit SideWriter(std::string dir) : dir_(std::move(dir)) {
    std::filesystem::create_directories(dir_);
  }
  SideWriter(const SideWriter&) = delete;
  SideWriter& operator=(const SideWriter&) = delete;
  ~SideWriter() { Close(); }

  // Starts the document DIR/<name>.xml with its declaration and root start tag.
  void Open(std::string_view name) {
    std::string path = dir_ + "/" + std::string(name) + ".xml";
    file_ = std::fopen(path.c_str(), "wb");
    if (file_ == nullptr) {
      std::perror(path.c_str());
      std::exit(1);
    }
    ++documents_;
    text += "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<Workspace";
    AppendAttribute(text, "Name", name);
    text += ">\n";
  }

  // Ends the current document, if any.
  void Close() {
    if (file_ == nullptr) return;
    text += "</Workspace>\n";
    Flush();
    if (std::fclose(file_) != 0) {
      std::perror(dir_.c_str());
      std::exit(1);
    }
    file_ = nullptr;
  }

  // Writes the buffer out once it is large enough to be worth a system call.
  void MaybeFlush() {
    if (text.size() >= (1u << 20)) Flush();
  }

  uint64_t bytes() const { return written_ + text.size(); }
  int documents() const { return documents_; }

  std::string text;  // what is appended here goes into the current document

 private:
  void Flush() {
    if (std::fwrite(text.data(), 1, text.size(), file_) != text.size()) {
      std::perror(dir_.c_str());
      std::exit(1);
    }
    written_ += text.size();
    text.clear();
  }

  std::string dir_;
  std::FILE* file_ = nullptr;
  uint64_t written_ = 0;
  int documents_ = 0;
};

// ---------------------------------------------------------------------------------------------
// Generation

enum Kind { FHBD, LHC, UHC, CHBD, MHBDM, NPVM, ADVHC, MRTHC, INDM, CINMA, PMHC, MOHBC, ARVHC };
constexpr const char* kKindNames[] = {"FHBD",  "LHC",  "UHC",   "CHBD", "MHBDM", "NPVM", "ADVHC",
                                      "MRTHC", "INDM", "CINMA", "PMHC", "MOHBC", "ARVHC"};
constexpr int kKindCount = 13;

// Which levels of a file may be changed: the growth shapes keep the elements that hold the
// repeated ones, so that the measured work stays the same.
struct Scope {
  bool files = true;
  bool classes = true;
};

// A name not yet in `taken`: `base`, or `base` followed by the first free number.
std::string UniqueName(std::unordered_set<std::string>& taken, std::string base) {
  if (taken.insert(base).second) return base;
  for (int k = 2;; ++k) {
    std::string candidate = base + std::to_string(k);
    if (taken.insert(candidate).second) return candidate;
  }
}

class Generator {
 public:
  explicit Generator(const Options& options)
      : options_(options),
        random_(options.seed),
        reference_(options.reference_dir),
        checked_(options.checked_dir) {}

  void Run();
  void PrintSummary() const;

 private:
  // Content
  File MakeFile(std::string_view prefix, long classes, long methods, bool flagged = false);
  Class MakeClass(std::string_view prefix, std::unordered_set<std::string>& names,
                  std::string_view aut, long methods);
  Method MakeMethod(std::unordered_set<std::string>& names, bool automation);
  Method MakeOverload(const Method& original);
  void MakeOverloadsOfOneName(Class& klass);
  Arg MakeArg(const std::vector<Arg>& siblings);
  std::string MakeMethodName();
  std::string MakeClassName(std::string_view prefix);

  // Changes on the checked side
  void Change(File& file, const Scope& scope);
  void ChangeFile(File& file);
  void ChangeClass(Class& klass, bool pure_virtual_checked);
  void ChangeMethod(Method& method, bool automation);
  void ChangeArg(Method& method, size_t k);
  template <size_t N>
  Kind PickKind(const Kind (&kinds)[N], const bool (&applicable)[N]);

  // Output
  void WriteWorkspace();
  void WriteGrowthShape();
  void BeginFramework(std::string_view name);
  void EndFramework();
  void BeginGroup(std::string_view name);
  void EndGroup();
  void WriteFilePair(File reference, const Scope& scope);
  std::string MakeFrameworkName(std::string_view prefix);

  const Options& options_;
  // The argument types of the overloads shape, which the methods point to.
  std::deque<std::string> overload_type_texts_;
  std::deque<TypeSpelling> overload_types_;
  Random random_;
  SideWriter reference_;
  SideWriter checked_;
  std::unordered_set<std::string> framework_names_;
  std::unordered_set<std::string> file_names_;  // of the current framework
  long changes_[kKindCount] = {};
  long respelled_ = 0;
  long files_ = 0, classes_ = 0, methods_ = 0, args_ = 0;
};

std::string Generator::MakeFrameworkName(std::string_view prefix) {
  std::string base(prefix);
  base += random_.Pick(kDomains);
  base += random_.Pick(kFrameworkEndings);
  return UniqueName(framework_names_, base);
}

std::string Generator::MakeClassName(std::string_view prefix) {
  std::string name(prefix);
  if (random_.Chance(0.6)) name += 'I';
  if (random_.Chance(0.5)) name += random_.Pick(kDomains);
  name += random_.Pick(kNouns);
  name += random_.Pick(kClassSuffixes);
  return name;
}

std::string Generator::MakeMethodName() {
  std::string name(random_.Pick(kVerbs));
  name += random_.Pick(kNouns);
  if (random_.Chance(0.3)) name += random_.Pick(kQualifiers);
  return name;
}

Arg Generator::MakeArg(const std::vector<Arg>& siblings) {
  Arg arg;
  arg.type = &random_.PickWeighted(kArgTypes);
  std::string base(arg.type->kind == 'o' ? "o" : "i");
  base += random_.Pick(kNouns);
  arg.name = base;
  for (int k = 2;; ++k) {
    bool taken = false;
    for (const Arg& sibling : siblings) taken = taken || sibling.name == arg.name;
    if (!taken) break;
    arg.name = base + std::to_string(k);
  }
  return arg;
}

// A default value that suits the argument's type, or none for the types that take none.
std::string_view DefaultValueFor(Random& random, const TypeSpelling& type) {
  switch (type.kind) {
    case 'i':
      return random.Pick(kIntegerValues);
    case 'f':
      return random.Pick(kFloatingValues);
    case 'b':
      return random.Pick(kBooleanValues);
    case 'p':
      return random.Pick(kPointerValues);
    case 's':
      return random.Pick(kStringValues);
    default:
      return {};
  }
}

Method Generator::MakeMethod(std::unordered_set<std::string>& names, bool automation) {
  Method method;
  method.name = UniqueName(names, MakeMethodName());
  method.access = random_.PickWeighted(kAccesses).text;
  method.type =
      automation && random_.Chance(0.8) ? "PureVirtual"sv : random_.PickWeighted(kMethodTypes).text;
  // Some non-virtual members, constructors among them, have no returned type.
  if (method.type != "NonVirtual" || random_.Chance(0.8)) {
    method.returned = &random_.PickWeighted(kReturnedTypes);
  }
  const Range& arg_range = random_.PickWeighted(kArgsPerMethod);
  long arg_count = random_.Between(arg_range.low, arg_range.high);
  for (long k = 0; k < arg_count; ++k) method.args.push_back(MakeArg(method.args));
  // Default values are trailing, as the language wants them.
  for (auto arg = method.args.rbegin(); arg != method.args.rend(); ++arg) {
    if (!random_.Chance(0.25)) break;
    arg->value = DefaultValueFor(random_, *arg->type);
    if (arg->value.empty()) break;
  }
  if (automation && !method.args.empty() && method.args.back().type->kind == 'o' &&
      random_.Chance(0.5)) {
    method.args.back().retval = true;
  }
  if (automation && random_.Chance(0.12)) method.property = random_.Chance(0.67) ? 'P' : 'R';
  method.nodoc = random_.Chance(0.03);
  if (random_.Chance(0.02)) method.deprecated = random_.Pick(kMethodDeprecations);
  return method;
}

// Another declaration of the same name with one more argument, so a different identity.
Method Generator::MakeOverload(const Method& original) {
  Method method = original;
  method.deprecated = {};
  method.nodoc = false;
  method.args.push_back(MakeArg(method.args));
  if (method.args.size() > 1 && !method.args[method.args.size() - 2].value.empty()) {
    method.args.back().value = DefaultValueFor(random_, *method.args.back().type);
  }
  return method;
}

// Makes every method of `klass` a public "Apply" taking one argument of a type of its own, so
// that their identities differ by the argument's type only: the worst case of pairing.
void Generator::MakeOverloadsOfOneName(Class& klass) {
  for (Method& method : klass.methods) {
    std::string& text = overload_type_texts_.emplace_back("Handle");
    text += std::to_string(overload_type_texts_.size());
    text += '*';
    const TypeSpelling& type = overload_types_.emplace_back(TypeSpelling{text, {}, 'p', 1});
    method.name = "Apply";
    method.access = "Public";
    method.args.assign(1, Arg{&type, "iHandle", {}, false});
  }
}

// `aut` is the class's automation flag when given, else drawn (only automation files hold
// automation classes); `methods` < 0 draws the method count.
Class Generator::MakeClass(std::string_view prefix, std::unordered_set<std::string>& names,
                           std::string_view aut, long methods) {
  Class klass;
  klass.name = UniqueName(names, MakeClassName(prefix));
  klass.aut = !aut.empty() ? aut : random_.Chance(0.75) ? "Y"sv : "N"sv;
  if (random_.Chance(0.03)) klass.deprecated = random_.Pick(kClassDeprecations);
  if (methods < 0) {
    const Range& range = random_.PickWeighted(kMethodsPerClass);
    methods = random_.Between(range.low, range.high);
  }
  bool automation = klass.aut == "Y";
  std::unordered_set<std::string> method_names;
  std::unordered_set<std::string> overloaded;  // one overload per name keeps identities unique
  klass.methods.reserve(methods);
  for (long m = 0; m < methods; ++m) {
    const Method* original = nullptr;
    if (!klass.methods.empty() && random_.Chance(0.04)) {
      original = &klass.methods[random_.Below(klass.methods.size())];
      if (!overloaded.insert(original->name).second) original = nullptr;
    }
    klass.methods.push_back(original != nullptr ? MakeOverload(*original)
                                                : MakeMethod(method_names, automation));
    args_ += klass.methods.back().args.size();
  }
  methods_ += methods;
  return klass;
}

// A flagged file is an automation file with level "L1" and usage "U2", whose classes are all
// automation classes: every rule applies to it.
File Generator::MakeFile(std::string_view prefix, long classes, long methods, bool flagged) {
  File file;
  file.aut = flagged || random_.Chance(0.9) ? "Y"sv : "N"sv;
  file.level = flagged ? "L1"sv : random_.PickWeighted(kLevels).text;
  if (flagged) {
    file.usage = "U2";
  } else if (!file.level.empty() && random_.Chance(0.99)) {
    file.usage = random_.PickWeighted(kUsages).text;
  }
  if (classes < 0) {
    const Range& range = random_.PickWeighted(kClassesPerFile);
    classes = random_.Between(range.low, range.high);
  }
  std::string_view class_aut = flagged ? "Y"sv : file.aut == "Y" ? ""sv : "N"sv;
  std::unordered_set<std::string> class_names;
  for (long c = 0; c < classes; ++c) {
    file.classes.push_back(MakeClass(prefix, class_names, class_aut, methods));
  }
  std::string base = classes > 0 ? file.classes.front().name
                                 : std::string(prefix) + std::string(random_.Pick(kNouns)) + "Defs";
  file.name = UniqueName(file_names_, base + ".h");
  ++files_;
  classes_ += classes;
  return file;
}

// ---------------------------------------------------------------------------------------------
// Changes. Each element of a changeable level may be changed, in one of the ways that lead to a
// finding at its level and apply to it.

template <size_t N>
Kind Generator::PickKind(const Kind (&kinds)[N], const bool (&applicable)[N]) {
  size_t count = 0;
  for (bool a : applicable) count += a;
  size_t ticket = random_.Below(count);
  for (size_t k = 0; k < N; ++k) {
    if (applicable[k] && ticket-- == 0) return kinds[k];
  }
  return kinds[0];
}

// A usage change that the rules forbid.
std::string_view ForbiddenUsage(std::string_view usage) {
  if (usage == "U1") return "U3";
  if (usage == "U2") return "U1";
  if (usage == "U3") return "U1";
  if (usage == "U4") return "U3";
  return "U2";
}

void Generator::ChangeFile(File& file) {
  const Kind kinds[] = {FHBD, LHC, UHC};
  const bool applicable[] = {true, file.level == "L1", file.level == "L1" && !file.usage.empty()};
  Kind kind = PickKind(kinds, applicable);
  ++changes_[kind];
  if (kind == FHBD) file.removed = true;
  if (kind == LHC) file.level = "L2";
  if (kind == UHC) file.usage = ForbiddenUsage(file.usage);
}

void Generator::ChangeClass(Class& klass, bool pure_virtual_checked) {
  size_t swap_at = klass.methods.size();  // first of two compared neighbours, from a random start
  for (size_t n = 1, start = random_.Below(klass.methods.size() + 1); n < klass.methods.size();
       ++n) {
    size_t i = (start + n) % klass.methods.size();
    if (i + 1 < klass.methods.size() && IsCompared(klass.methods[i]) &&
        IsCompared(klass.methods[i + 1])) {
      swap_at = i;
      break;
    }
  }
  const Kind kinds[] = {CHBD, CINMA, MOHBC, NPVM};
  const bool applicable[] = {true, klass.aut == "Y",
                             klass.aut == "Y" && swap_at < klass.methods.size(),
                             pure_virtual_checked};
  Kind kind = PickKind(kinds, applicable);
  ++changes_[kind];
  if (kind == CHBD) klass.removed = true;
  if (kind == CINMA) klass.aut = "N";
  if (kind == MOHBC) std::swap(klass.methods[swap_at], klass.methods[swap_at + 1]);
  if (kind == NPVM) {
    // Added at the end, as a developer who knows the order rule would; the name carries a
    // suffix that generated names never have, so it is new.
    std::unordered_set<std::string> none;
    Method added = MakeMethod(none, true);
    added.name += "V2";
    added.access = "Public";
    added.type = "PureVirtual";
    added.deprecated = {};
    klass.methods.push_back(std::move(added));
  }
}

void Generator::ChangeMethod(Method& method, bool automation) {
  const Kind kinds[] = {MHBDM, MRTHC, INDM, PMHC};
  const bool applicable[] = {true, true, !method.nodoc,
                             automation && (method.property == 'P' || method.property == 'R')};
  Kind kind = PickKind(kinds, applicable);
  ++changes_[kind];
  if (kind == MHBDM) {
    // Deleted, made private, or an argument's type changed: the identity is lost each way.
    size_t way = random_.Below(method.args.empty() ? 2 : 3);
    if (way == 0) method.removed = true;
    if (way == 1) method.access = method.access == "Private" ? "Public"sv : "Private"sv;
    if (way == 2) {
      Arg& arg = method.args[random_.Below(method.args.size())];
      const TypeSpelling* type = arg.type;
      while (NormalName(*type) == NormalName(*arg.type)) type = &random_.PickWeighted(kArgTypes);
      arg.type = type;
    }
  }
  if (kind == MRTHC) {
    const TypeSpelling* type = method.returned;
    while (type == method.returned || (type != nullptr && method.returned != nullptr &&
                                       NormalName(*type) == NormalName(*method.returned))) {
      type = random_.Chance(0.1) ? nullptr : &random_.PickWeighted(kReturnedTypes);
    }
    method.returned = type;
  }
  if (kind == INDM) method.nodoc = true;
  if (kind == PMHC) method.property = method.property == 'P' ? 'R' : 0;
}

void Generator::ChangeArg(Method& method, size_t k) {
  Arg& arg = method.args[k];
  Kind kind = random_.Chance(0.5) ? ADVHC : ARVHC;
  ++changes_[kind];
  if (kind == ADVHC) {
    std::string_view value = arg.value;
    std::string_view candidate = DefaultValueFor(random_, *arg.type);
    if (candidate.empty()) candidate = "0";
    // Added, changed, or (one time in four) removed.
    arg.value = !value.empty() && (candidate == value || random_.Chance(0.25)) ? ""sv : candidate;
    return;
  }
  // The automation return value moves here from another argument, or away from here.
  if (arg.retval) {
    arg.retval = false;
    if (method.args.size() > 1) method.args[(k + 1) % method.args.size()].retval = true;
    return;
  }
  for (Arg& other : method.args) other.retval = false;
  arg.retval = true;
}

void Generator::Change(File& file, const Scope& scope) {
  // Files and classes are few beside methods and arguments: changed three times as often, their
  // findings show up in small workspaces too, and the whole stays near one change in a hundred.
  const double outer_rate = 3 * options_.change_rate;
  if (scope.files && random_.Chance(outer_rate)) ChangeFile(file);
  if (file.removed) return;
  bool pure_virtual_checked = file.usage == "U2" || file.usage == "U5";
  for (Class& klass : file.classes) {
    size_t declared = klass.methods.size();  // a new pure virtual method stays as it is
    if (scope.classes && random_.Chance(outer_rate)) {
      ChangeClass(klass, pure_virtual_checked);
    }
    if (klass.removed) continue;
    bool automation = klass.aut == "Y";
    for (size_t m = 0; m < declared; ++m) {
      Method& method = klass.methods[m];
      if (random_.Chance(options_.change_rate)) ChangeMethod(method, automation);
      for (size_t k = 0; k < method.args.size(); ++k) {
        if (random_.Chance(options_.change_rate)) ChangeArg(method, k);
        // Another spelling of the same type: no finding, but the normalisation has work to do.
        const TypeSpelling* type = method.args[k].type;
        if (!type->normal.empty() && random_.Chance(0.02)) {
          const TypeSpelling* other = &random_.PickWeighted(kArgTypes);
          if (other != type && other->normal == type->normal) {
            method.args[k].type = other;
            ++respelled_;
          }
        }
      }
    }
  }
}

// ---------------------------------------------------------------------------------------------
// Documents

void Generator::BeginFramework(std::string_view name) {
  if (options_.layout == Layout::kDirectory) {
    reference_.Open(name);
    checked_.Open(name);
  }
  for (SideWriter* side : {&reference_, &checked_}) {
    AppendIndent(side->text, 1);
    side->text += "<Framework";
    AppendAttribute(side->text, "Name", name);
    side->text += ">\n";
  }
  file_names_.clear();
}

void Generator::EndFramework() {
  for (SideWriter* side : {&reference_, &checked_}) {
    AppendIndent(side->text, 1);
    side->text += "</Framework>\n";
  }
  if (options_.layout == Layout::kDirectory) {
    reference_.Close();
    checked_.Close();
  }
}

void Generator::BeginGroup(std::string_view name) {
  for (SideWriter* side : {&reference_, &checked_}) {
    AppendIndent(side->text, 2);
    side->text += "<Interfaces";
    AppendAttribute(side->text, "Name", name);
    side->text += ">\n";
  }
}

void Generator::EndGroup() {
  for (SideWriter* side : {&reference_, &checked_}) {
    AppendIndent(side->text, 2);
    side->text += "</Interfaces>\n";
  }
}

void Generator::WriteFilePair(File reference, const Scope& scope) {
  WriteFile(reference_.text, reference);
  Change(reference, scope);  // the copy becomes the checked file
  if (!reference.removed) WriteFile(checked_.text, reference);
  reference_.MaybeFlush();
  checked_.MaybeFlush();
}

void Generator::WriteWorkspace() {
  const uint64_t target = static_cast<uint64_t>(options_.megabytes * 1048576.0);
  const Scope scope;
  while (reference_.bytes() < target) {
    std::string_view prefix = random_.Pick(kPrefixes);
    BeginFramework(MakeFrameworkName(prefix));
    // Frameworks from a few hundred kilobytes to a few megabytes; a fifth of the files are
    // protected, in two frameworks out of three.
    uint64_t budget = random_.Between(300, 2500) * uint64_t{1024};
    bool has_protected = random_.Chance(0.67);
    uint64_t public_end = reference_.bytes() + (has_protected ? budget * 4 / 5 : budget);
    uint64_t framework_end = reference_.bytes() + budget;
    BeginGroup("Public");
    do {
      WriteFilePair(MakeFile(prefix, -1, -1), scope);
    } while (reference_.bytes() < std::min(public_end, target));
    EndGroup();
    if (has_protected && reference_.bytes() < target) {
      BeginGroup("Protected");
      do {
        WriteFilePair(MakeFile(prefix, -1, -1), scope);
      } while (reference_.bytes() < std::min(framework_end, target));
      EndGroup();
    }
    EndFramework();
  }
}

void Generator::WriteGrowthShape() {
  std::string_view prefix = random_.Pick(kPrefixes);
  BeginFramework(MakeFrameworkName(prefix));
  BeginGroup("Public");
  if (options_.shape == Shape::kGroup) {
    for (long f = 0; f < options_.count; ++f) WriteFilePair(MakeFile(prefix, 1, 3), Scope{});
  } else if (options_.shape == Shape::kFile) {
    WriteFilePair(MakeFile(prefix, options_.count, 3, true), Scope{false, true});
  } else if (options_.shape == Shape::kOverloads) {
    File file = MakeFile(prefix, 1, options_.count, true);
    MakeOverloadsOfOneName(file.classes.front());
    WriteFilePair(std::move(file), Scope{false, false});
  } else {
    WriteFilePair(MakeFile(prefix, 1, options_.count, true), Scope{false, false});
  }
  EndGroup();
  EndFramework();
}

void Generator::Run() {
  if (options_.layout == Layout::kSingle) {
    reference_.Open("Workspace");
    checked_.Open("Workspace");
  }
  if (options_.shape == Shape::kWorkspace) {
    WriteWorkspace();
  } else {
    WriteGrowthShape();
  }
  reference_.Close();
  checked_.Close();
}

void Generator::PrintSummary() const {
  std::printf("reference: %llu bytes in %d document(s); checked: %llu bytes\n",
              static_cast<unsigned long long>(reference_.bytes()), reference_.documents(),
              static_cast<unsigned long long>(checked_.bytes()));
  std::printf("frameworks %zu, files %ld, classes %ld, methods %ld, args %ld\n",
              framework_names_.size(), files_, classes_, methods_, args_);
  std::printf("changes:");
  for (int k = 0; k < kKindCount; ++k) std::printf(" %s %ld", kKindNames[k], changes_[k]);
  std::printf("; respelled types %ld\n", respelled_);
}

}  // namespace

int main(int argc, char** argv) {
  Options options = ParseOptions(argc, argv);
  Generator generator(options);
  generator.Run();
  generator.PrintSummary();
  return 0;
}
