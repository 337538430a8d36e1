// Prints what the numerical functions make of every row of their test tables, and what the C library's
// functions under them make of pseudo-random arguments, each number with all its digits: the outputs of two
// systems are compared line by line. A section begins with "# " and its name. With `--host-thread` a thread
// computes that was made as hosts on Windows may make theirs, by the system itself: its x87 unit begins cut
// to the length of a double.

#include <charconv>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <exception>
#include <iostream>
#include <map>
#include <string>
#include <vector>

#ifdef _WIN32
#include <windows.h>
#endif

#include "kestrel/math/MCDistFun.h"
#include "plugins/regression/LinkFunctions.h"
#include "tests/math/DistFunWorkers.h"
#include "tests/math/ReferenceFunctions.h"
#include "tests/support/PlainTable.h"

namespace {

using kestrel_tests::PlainTable;
using MCKestrel_800::Normalization;
using MCMath_800::DistFunWorkers;
using MCMath_800::MCDistFun;

void PrintSection(const std::string& name) {
  std::cout << "# " << name << '\n';
}

/// As the shortest text that reads back, which takes 17 digits at most.
void PrintNumber(double number) {
  char text[32];
  const std::to_chars_result end = std::to_chars(text, text + sizeof text, number);
  *end.ptr = '\n';
  std::cout.write(text, end.ptr + 1 - text);
}

double ToNumber(const std::string& cell) {
  return std::strtod(cell.c_str(), nullptr);
}

PlainTable TestTable(const char* path) {
  return kestrel_tests::ReadPlainTable(std::string(KESTREL_SOURCE_DIR "/tests/data/") + path);
}

/// Arguments that are the same everywhere: sums and products alone make them.
class Arguments {
 public:
  /// Between two numbers.
  double Even(double low, double high) {
    state_ ^= state_ << 13;
    state_ ^= state_ >> 7;
    state_ ^= state_ << 17;
    return low + (high - low) * (static_cast<double>(state_ >> 11) * 0x1p-53);
  }
  /// Of an exponent between two.
  double Spread(double low, double high) {
    const double exponent = std::floor(Even(low, high));
    return std::ldexp(1.0 + Even(0.0, 1.0), static_cast<int>(exponent));
  }

 private:
  std::uint64_t state_ = 88172645463325252u;
};

struct CFunction {
  const char* name;
  double (*call)(Arguments& arguments);
};

// Those that the sources call, over such arguments as they meet. Two arguments are drawn one after the other:
// no rule says which of a call's is evaluated first.
constexpr CFunction kCFunctions[] = {
    {"sqrt", [](Arguments& a) { return std::sqrt(a.Spread(-1000, 1000)); }},
    {"floor", [](Arguments& a) { return std::floor(a.Spread(-10, 60)); }},
    {"ceil", [](Arguments& a) { return std::ceil(a.Spread(-10, 60)); }},
    {"fmod(x, 2)", [](Arguments& a) { return std::fmod(a.Spread(-2, 52), 2.0); }},
    {"exp within 1", [](Arguments& a) { return std::exp(a.Even(-1.0, 1.0)); }},
    {"exp within 700", [](Arguments& a) { return std::exp(a.Even(-700.0, 700.0)); }},
    {"exp of denormal results", [](Arguments& a) { return std::exp(a.Even(-745.0, -708.0)); }},
    {"log near 1", [](Arguments& a) { return std::log(a.Even(0.5, 2.0)); }},
    {"log", [](Arguments& a) { return std::log(a.Spread(-1000, 1000)); }},
    {"log1p", [](Arguments& a) { return std::log1p(a.Even(-0.9, 2.0)); }},
    {"expm1 within 1", [](Arguments& a) { return std::expm1(a.Even(-1.0, 1.0)); }},
    {"expm1 within 40", [](Arguments& a) { return std::expm1(a.Even(-40.0, 40.0)); }},
    {"pow",
     [](Arguments& a) {
       const double x = a.Even(0.0, 10.0);
       return std::pow(x, a.Even(-3.0, 3.0));
     }},
    {"pow of large powers",
     [](Arguments& a) {
       const double x = a.Spread(-30, 30);
       return std::pow(x, a.Even(-30.0, 30.0));
     }},
    {"pow of whole exponents to 10",
     [](Arguments& a) {
       const double x = a.Even(0.0, 10.0);
       return std::pow(x, std::floor(a.Even(-10.0, 11.0)));
     }},
    {"pow of whole exponents to 1000",
     [](Arguments& a) {
       const double x = a.Even(0.9, 1.1);
       return std::pow(x, std::floor(a.Even(-1000.0, 1001.0)));
     }},
    {"erf", [](Arguments& a) { return std::erf(a.Even(-6.0, 6.0)); }},
    {"erfc", [](Arguments& a) { return std::erfc(a.Even(-6.0, 26.0)); }},
    {"atan", [](Arguments& a) { return std::atan(a.Even(-5.0, 5.0)); }},
    {"atan2",
     [](Arguments& a) {
       const double x = a.Even(-3.0, 3.0);
       return std::atan2(x, a.Even(-3.0, 3.0));
     }},
    {"sin", [](Arguments& a) { return std::sin(a.Even(-4.0, 4.0)); }},
    {"cos", [](Arguments& a) { return std::cos(a.Even(-4.0, 4.0)); }},
    {"tan", [](Arguments& a) { return std::tan(a.Even(-1.5, 1.5)); }},
    {"sinh", [](Arguments& a) { return std::sinh(a.Even(-40.0, 40.0)); }},
    {"asinh", [](Arguments& a) { return std::asinh(a.Spread(-10, 300)); }},
    {"hypot",
     [](Arguments& a) {
       const double x = a.Even(-3.0, 3.0);
       return std::hypot(x, a.Even(-3.0, 3.0));
     }},
};

void PrintCFunctions() {
  for (const CFunction& function : kCFunctions) {
    PrintSection(std::string("C library: ") + function.name);
    Arguments arguments;
    for (int i = 0; i < 4000; ++i)
      PrintNumber(function.call(arguments));
  }
}

void PrintReferenceFunctions() {
  for (const kestrel_tests::ReferenceFunction& function : kestrel_tests::ReferenceFunctions()) {
    PrintSection(std::string(function.table) + ".csv: " + function.name);
    for (const kestrel_tests::ReferencePoint& point : kestrel_tests::ReadReferencePoints(function, 1))
      PrintNumber(function.call(point.arguments));
  }
}

double LogBinomial(double n, double k, double) {
  long error = 0;
  return DistFunWorkers::dnlbnc(n, k, error);
}

using FamilyFunction = double (*)(double, double, double);

const std::map<std::string, FamilyFunction>& FamilyFunctions() {
  static const std::map<std::string, FamilyFunction> functions = {
      {"derf", [](double x, double, double) { return DistFunWorkers::derf(x); }},
      {"derfc", [](double x, double, double) { return DistFunWorkers::derfc(x); }},
      {"dnlbnc", LogBinomial},
      {"vexadnlgam", [](double x, double, double) { return MCDistFun::vexadnlgam(x); }},
      {"CdfStdNorm", [](double x, double, double) { return MCDistFun::CdfStdNorm(x); }},
      {"IdfStdNorm", [](double p, double, double) { return MCDistFun::IdfStdNorm(p); }},
      {"CdfChi", [](double x, double df, double) { return MCDistFun::CdfChi(x, df); }},
      {"SigChi", [](double x, double df, double) { return MCDistFun::SigChi(x, df); }},
      {"CdfT", [](double x, double df, double) { return MCDistFun::CdfT(x, df); }},
      {"SigT", [](double x, double df, double) { return MCDistFun::SigT(x, df); }},
      {"CdfF", MCDistFun::CdfF},
      {"SigF", MCDistFun::SigF},
      {"CdfBeta", MCDistFun::CdfBeta},
      {"CdfGam", MCDistFun::CdfGam},
  };
  return functions;
}

void PrintFamilyValues() {
  const PlainTable table = TestTable("math/family_values.csv");
  for (const auto& [name, function] : FamilyFunctions()) {
    PrintSection("family_values.csv: " + name);
    for (const std::vector<std::string>& row : table.rows) {
      if (row[0] == name) PrintNumber(function(ToNumber(row[1]), ToNumber(row[2]), ToNumber(row[3])));
    }
  }
}

/// Rows in their order, a section for each run of rows with the same method.
void PrintLinks() {
  std::string method_before;
  for (const std::vector<std::string>& row : TestTable("regression/links.csv").rows) {
    if (row[0] != method_before) PrintSection("links.csv: " + row[0]);
    method_before = row[0];
    Normalization method;
    if (!MCKestrel_800::FindNormalization(row[0], method)) continue;
    const double low = ToNumber(row[2]), high = ToNumber(row[3]);
    PrintNumber(row[1] == "below"   ? MCKestrel_800::LinkBelow(method, low)
                : row[1] == "above" ? MCKestrel_800::LinkAbove(method, low)
                                    : MCKestrel_800::LinkBetween(method, low, high));
  }
  method_before.clear();
  for (const std::vector<std::string>& row : TestTable("regression/shares.csv").rows) {
    if (row[0] != method_before) PrintSection("shares.csv: " + row[0]);
    method_before = row[0];
    Normalization method;
    if (!MCKestrel_800::FindNormalization(row[0], method)) continue;
    const double values[] = {ToNumber(row[1]), ToNumber(row[2]), ToNumber(row[3])};
    double shares[3];
    MCKestrel_800::LinkShares(method, values, 3, shares);
    for (const double share : shares)
      PrintNumber(share);
  }
}

/// Whether all could be computed and printed.
bool PrintAll() {
  try {
    PrintCFunctions();
    PrintReferenceFunctions();
    PrintFamilyValues();
    PrintLinks();
    std::cout.flush();
    return std::cout.good();
  } catch (const std::exception& e) {
    std::cerr << "print_digits: " << e.what() << '\n';
    return false;
  }
}

#ifdef _WIN32
DWORD WINAPI PrintOnThread(void* printed) {
  *static_cast<bool*>(printed) = PrintAll();
  return 0;
}

bool PrintOnHostThread() {
  bool printed = false;
  const HANDLE thread = CreateThread(nullptr, 0, PrintOnThread, &printed, 0, nullptr);
  if (thread == nullptr) return false;
  WaitForSingleObject(thread, INFINITE);
  CloseHandle(thread);
  return printed;
}
#else
bool PrintOnHostThread() {
  return PrintAll();
}
#endif

}  // namespace

int main(int argc, char** argv) {
  const bool on_host_thread = argc > 1 && std::string(argv[1]) == "--host-thread";
  return (on_host_thread ? PrintOnHostThread() : PrintAll()) ? 0 : 1;
}
