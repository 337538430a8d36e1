// Documents of derived fields: a large table, and shapes that grow in one direction each.

#ifndef KESTREL_BENCH_LOAD_DERIVEDDOCUMENTS_H
#define KESTREL_BENCH_LOAD_DERIVEDDOCUMENTS_H

#include <cstddef>
#include <string>
#include <vector>

#include "bench/support/Documents.h"

namespace kestrel_bench {

inline std::string DerivedDocument(const std::string& fields) {
  return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<PMML version=\"4.4\"><DataDictionary "
         "numberOfFields=\"2\">"
         "<DataField name=\"x\" optype=\"continuous\" dataType=\"double\"/>"
         "<DataField name=\"t\" optype=\"categorical\" dataType=\"string\"/></DataDictionary>"
         "<TransformationDictionary>" +
         fields + "</TransformationDictionary></PMML>\n";
}

inline std::string DerivedField(const std::string& name, const std::string& type,
                                const std::string& content) {
  return "<DerivedField name=\"" + name + "\" " + type + ">" + content + "</DerivedField>\n";
}

constexpr char kNumber[] = "optype=\"continuous\" dataType=\"double\"";
constexpr char kCategory[] = "optype=\"categorical\" dataType=\"string\"";

/// n pieces of text, each made from its number.
template <typename Make>
std::string Pieces(std::size_t n, Make make) {
  std::string text;
  for (std::size_t i = 0; i < n; ++i)
    text += make(std::to_string(i));
  return text;
}

inline std::string TableOf(std::size_t n, const char* type, const std::string& output_prefix) {
  return DerivedField(
      "d", type,
      "<MapValues outputColumn=\"out\"><FieldColumnPair field=\"t\" column=\"in\"/><InlineTable>\n" +
          Pieces(n,
                 [&](const std::string& i) {
                   return "<row><in>item " + i + "</in><out>" + output_prefix + i + ".25</out></row>\n";
                 }) +
          "</InlineTable></MapValues>");
}

/// A table that makes numbers of texts, and one whose outputs are categories.
inline std::string TableDocument(std::size_t n) {
  return DerivedDocument(TableOf(n, kNumber, ""));
}
inline std::string CategoryTableDocument(std::size_t n) {
  return DerivedDocument(TableOf(n, kCategory, "group "));
}

inline std::string FieldsDocument(std::size_t n) {
  return DerivedDocument(Pieces(n, [](const std::string& i) {
    return DerivedField("d" + i, kNumber,
                        "<Apply function=\"+\"><FieldRef field=\"x\"/><Constant dataType=\"double\">" + i +
                            "</Constant></Apply>");
  }));
}

/// Each field reads the one before.
inline std::string ChainDocument(std::size_t n) {
  return DerivedDocument(Pieces(n, [](const std::string& i) {
    const std::string before = i == "0" ? "x" : "d" + std::to_string(std::stoul(i) - 1);
    return DerivedField("d" + i, kNumber, "<FieldRef field=\"" + before + "\"/>");
  }));
}

inline std::string PointsDocument(std::size_t n) {
  return DerivedDocument(
      DerivedField("d", kNumber, "<NormContinuous field=\"x\">" + Pieces(n + 2, [](const std::string& i) {
                                   return "<LinearNorm orig=\"" + i + "\" norm=\"0." + i + "\"/>";
                                 }) + "</NormContinuous>"));
}

inline std::string BinsDocument(std::size_t n) {
  return DerivedDocument(
      DerivedField("d", kCategory, "<Discretize field=\"x\">" + Pieces(n + 1, [](const std::string& i) {
                                     return "<DiscretizeBin binValue=\"b" + i +
                                            "\"><Interval closure=\"openClosed\" leftMargin=\"" + i +
                                            "\" rightMargin=\"" + i + ".5\"/></DiscretizeBin>";
                                   }) + "</Discretize>"));
}

inline std::string ArgumentsDocument(std::size_t n) {
  return DerivedDocument(
      DerivedField("d", kNumber, "<Apply function=\"sum\">" + Pieces(n + 1, [](const std::string& i) {
                                   return "<Apply function=\"abs\"><Constant dataType=\"double\">" + i +
                                          "</Constant></Apply>";
                                 }) + "</Apply>"));
}

inline std::string SetDocument(std::size_t n) {
  return DerivedDocument(DerivedField(
      "d", kNumber,
      "<Apply function=\"isIn\"><FieldRef field=\"t\"/><Array type=\"string\">" +
          Pieces(n + 1, [](const std::string& i) { return "v" + i + " "; }) + "</Array></Apply>"));
}

inline std::string ListedSetDocument(std::size_t n) {
  return DerivedDocument(DerivedField(
      "d", kNumber,
      "<Apply function=\"isIn\"><FieldRef field=\"t\"/>" + Pieces(n + 1, [](const std::string& i) {
        return "<Constant>v" + i + "</Constant>";
      }) + "</Apply>"));
}

/// Values in a list behind a deep argument, whose type is that of the innermost one.
inline std::string DeepSetDocument(std::size_t n) {
  std::string argument = "<FieldRef field=\"t\"/>";
  for (int depth = 0; depth < 500; ++depth)
    argument = "<Apply function=\"if\"><FieldRef field=\"x\"/>" + argument + "</Apply>";
  return DerivedDocument(DerivedField("d", kNumber,
                                      "<Apply function=\"isIn\">" + argument + "<Array type=\"string\">" +
                                          Pieces(n + 1, [](const std::string& i) { return "v" + i + " "; }) +
                                          "</Array></Apply>"));
}

inline std::string ValuesDocument(std::size_t n) {
  return DerivedDocument(
      DerivedField("d", kCategory, "<FieldRef field=\"t\"/>" + Pieces(n, [](const std::string& i) {
                                     return "<Value value=\"v" + i + "\"/><Value value=\"m" + i +
                                            "\" property=\"missing\"/>";
                                   })));
}

/// Everything that may be large in derived fields by itself.
inline std::vector<GrowthShape> DerivedShapes() {
  return {{"derived fields", FieldsDocument},
          {"derived fields that read the one before", ChainDocument},
          {"rows of a table", TableDocument},
          {"rows of a table of categories", CategoryTableDocument},
          {"points of a norm", PointsDocument},
          {"bins", BinsDocument},
          {"arguments of a function", ArgumentsDocument},
          {"elements of a function's set", SetDocument},
          {"constants of a function's set", ListedSetDocument},
          {"elements of a set behind a deep argument", DeepSetDocument},
          {"valid and missing values of a derived field", ValuesDocument}};
}

}  // namespace kestrel_bench

#endif  // KESTREL_BENCH_LOAD_DERIVEDDOCUMENTS_H
