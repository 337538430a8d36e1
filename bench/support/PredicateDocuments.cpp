#include "bench/support/PredicateDocuments.h"

#include <string>

namespace kestrel_bench {

namespace {

/// The i-th of n categories, out of order.
std::string Category(size_t i, size_t n) {
  return "category" + std::to_string(i * 7919 % n);
}

std::string Document(const char* optype, size_t categories, const std::string& predicate) {
  std::string values;
  for (size_t i = 0; i < categories; ++i)
    values += "<Value value=\"" + Category(i, categories) + "\"/>\n";
  return "<PMML>\n<DataDictionary numberOfFields=\"1\"><DataField name=\"f\" dataType=\"string\" optype=\"" +
         std::string(optype) + "\">\n" + values + "</DataField></DataDictionary>\n" + predicate + "</PMML>\n";
}

std::string Compound(const std::string& children) {
  return "<CompoundPredicate booleanOperator=\"or\">\n" + children + "</CompoundPredicate>\n";
}

std::string Simple(const char* operatorText, const std::string& value) {
  return "<SimplePredicate field=\"f\" operator=\"" + std::string(operatorText) + "\" value=\"" + value +
         "\"/>\n";
}

std::string Set(const char* operatorText, const std::string& elements) {
  return "<SimpleSetPredicate field=\"f\" booleanOperator=\"" + std::string(operatorText) +
         "\"><Array type=\"string\">" + elements + "</Array></SimpleSetPredicate>\n";
}

std::string ManyComplements(size_t n) {
  std::string children;
  for (size_t i = 0; i < n; ++i)
    children += Simple("notEqual", Category(i * 3, n));
  return Document("categorical", n, Compound(children));
}

std::string ManySetComplements(size_t n) {
  std::string children;
  for (size_t i = 0; i < n; ++i)
    children += Set("isNotIn", Category(i * 3, n));
  return Document("categorical", n, Compound(children));
}

std::string ManyIntervals(size_t n) {
  std::string children;
  for (size_t i = 0; i < n; ++i)
    children += Simple("lessOrEqual", Category(i * 3, n));
  return Document("ordinal", n, Compound(children));
}

std::string LongSet(const char* operatorText, size_t n) {
  std::string elements;
  for (size_t i = 0; i < n; ++i)
    elements += Category(i * 3, n) + " ";
  return Document("categorical", 2 * n, Set(operatorText, elements));
}

std::string ManyChildren(size_t n) {
  std::string children;
  for (size_t i = 0; i < n; ++i)
    children += i % 3 == 0 ? "<True/>\n" : Simple("equal", Category(i % 10, 10));
  return Document("categorical", 10, Compound(children));
}

}  // namespace

const std::vector<GrowthShape>& PredicateShapes() {
  static const std::vector<GrowthShape> shapes = {
      {"\"notEqual\" on a field with n categories", ManyComplements},
      {"\"isNotIn\" on a field with n categories", ManySetComplements},
      {"\"lessOrEqual\" on a field with n categories", ManyIntervals},
      {"elements of one set, \"isIn\"", [](size_t n) { return LongSet("isIn", n); }},
      {"elements of one set, \"isNotIn\"", [](size_t n) { return LongSet("isNotIn", n); }},
      {"children of one compound", ManyChildren},
  };
  return shapes;
}

}  // namespace kestrel_bench
