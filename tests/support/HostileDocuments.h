// Documents made to harm whoever reads them: they expand, nest or name without end, or reach for what lies
// outside.

#ifndef KESTREL_TESTS_SUPPORT_HOSTILEDOCUMENTS_H
#define KESTREL_TESTS_SUPPORT_HOSTILEDOCUMENTS_H

#include <cstddef>
#include <string>
#include <vector>

namespace kestrel_tests {

struct HostileDocument {
  std::string why;
  std::string text;
};

inline std::string Repeat(const std::string& text, size_t times) {
  std::string result;
  result.reserve(text.size() * times);
  for (size_t i = 0; i < times; ++i)
    result += text;
  return result;
}

/// Entities of ten references each to the one before: 10 to the power of `levels` copies of `seed`.
inline std::string LaughingEntities(size_t levels, const std::string& seed) {
  std::string result = "<!ENTITY e0 \"" + seed + "\">";
  for (size_t i = 1; i <= levels; ++i) {
    const std::string reference = "&e" + std::to_string(i - 1) + ";";
    result += "<!ENTITY e" + std::to_string(i) + " \"" + Repeat(reference, 10) + "\">";
  }
  return result;
}

inline std::string WithSubset(const std::string& subset, const std::string& root) {
  return "<?xml version=\"1.0\"?><!DOCTYPE PMML [" + subset + "]>" + root;
}

inline std::string ParameterLaughs() {
  std::string subset = "<!ENTITY % p0 \"<!ENTITY x 'x'>\">";
  for (int i = 1; i <= 12; ++i) {
    const std::string reference = "&#37;p" + std::to_string(i - 1) + ";";
    subset += "<!ENTITY % p" + std::to_string(i) + " \"" + Repeat(reference, 10) + "\">";
  }
  return WithSubset(subset + "%p12;", "<PMML/>");
}

inline std::string NumberedElements(size_t count) {
  std::string result = "<PMML>";
  for (size_t i = 0; i < count; ++i)
    result += "<n" + std::to_string(i) + "/>";
  return result + "</PMML>";
}

/// Names that fall into one bucket of the parser's table (its hash is the text read as digits to the base
/// 38), so that each look-up costs as much as there are names.
inline std::string CollidingNames(size_t names, size_t elements) {
  std::vector<std::string> tags;
  for (unsigned long number = 0; tags.size() < names; ++number) {
    std::string tag;
    unsigned long hash = 0;
    for (unsigned long rest = number, i = 0; i < 6; ++i, rest /= 26)
      tag += static_cast<char>('a' + rest % 26);
    for (const char c : tag)
      hash = hash * 38 + (hash >> 24) + static_cast<unsigned char>(c);
    if (hash % 257 == 7) tags.push_back("<" + tag + "/>");
  }
  std::string result = "<PMML>";
  for (size_t i = 0; i < elements; ++i)
    result += tags[i % names];
  return result + "</PMML>";
}

inline std::string NumberedAttributes(size_t count) {
  std::string result = "<PMML";
  for (size_t i = 0; i < count; ++i)
    result += " a" + std::to_string(i) + "=\"1\"";
  return result + "/>";
}

inline std::string DefaultAttributes(size_t attributes, size_t elements) {
  std::string subset = "<!ATTLIST r";
  for (size_t i = 0; i < attributes; ++i)
    subset += " a" + std::to_string(i) + " CDATA \"v\"";
  return WithSubset(subset + ">", "<PMML>" + Repeat("<r/>", elements) + "</PMML>");
}

/// Every kind of document whose reading would cost far more than its size, or go too deep.
inline std::vector<HostileDocument> Bombs() {
  const std::string big(100000, 'x');
  return {
      {"entities, 6 levels, in text", WithSubset(LaughingEntities(6, "ha"), "<PMML>&e6;</PMML>")},
      {"entities, 10 levels, in text", WithSubset(LaughingEntities(10, "ha"), "<PMML>&e10;</PMML>")},
      {"entities, 10 levels, in an attribute", WithSubset(LaughingEntities(10, "ha"), "<PMML a=\"&e10;\"/>")},
      {"entities, 10 levels, in a default attribute",
       WithSubset(LaughingEntities(10, "ha") + "<!ATTLIST PMML a CDATA \"&e10;\">", "<PMML/>")},
      {"empty entities, 10 levels, in a default attribute",
       WithSubset(LaughingEntities(10, "") + "<!ATTLIST PMML a CDATA \"&e10;\">", "<PMML/>")},
      {"empty entities, 10 levels, in text", WithSubset(LaughingEntities(10, ""), "<PMML>&e10;</PMML>")},
      {"entities that hold elements", WithSubset(LaughingEntities(9, "<a/>"), "<PMML>&e9;</PMML>")},
      {"parameter entities, 12 levels", ParameterLaughs()},
      {"one large entity used often in text",
       WithSubset("<!ENTITY e \"" + big + "\">", "<PMML>" + Repeat("<a>&e;</a>", 10000) + "</PMML>")},
      {"one large entity used often in attributes",
       WithSubset("<!ENTITY e \"" + big + "\">", "<PMML>" + Repeat("<a b=\"&e;\"/>", 10000) + "</PMML>")},
      {"one large default attribute of many elements",
       WithSubset("<!ATTLIST r a CDATA \"" + big + "\">", "<PMML>" + Repeat("<r/>", 10000) + "</PMML>")},
      {"many default attributes of many elements", DefaultAttributes(1000, 10000)},
      {"an entity within itself", WithSubset("<!ENTITY e \"&e;\">", "<PMML>&e;</PMML>")},
      {"an entity within itself, in an attribute", WithSubset("<!ENTITY e \"&e;\">", "<PMML a=\"&e;\"/>")},
      {"100,000 elements inside one another", Repeat("<a>", 100000) + Repeat("</a>", 100000)},
      {"100,000 elements inside one another, never closed", Repeat("<a>", 100000)},
      {"513 elements inside one another", Repeat("<a>", 513) + Repeat("</a>", 513)},
      {"nesting through entities",
       WithSubset("<!ENTITY e \"" + Repeat("<a>", 300) + Repeat("</a>", 300) + "\">",
                  Repeat("<a>", 300) + "&e;" + Repeat("</a>", 300))},
      {"257 attributes", NumberedAttributes(257)},
      {"100,000 attributes", NumberedAttributes(100000)},
      {"4,097 names", NumberedElements(4096)},
      {"100,000 names", NumberedElements(100000)},
      {"4,000 names that collide, on 1,000,000 elements", CollidingNames(4000, 1000000)},
  };
}

/// References to `target`, which must not be read, in every place where one may stand and is used.
inline std::vector<HostileDocument> OutsideReferences(const std::string& target) {
  const std::string entity = "<!ENTITY x SYSTEM \"" + target + "\">";
  return {
      {"entity in text: " + target, WithSubset(entity, "<PMML>&x;</PMML>")},
      {"public entity in text: " + target,
       WithSubset("<!ENTITY x PUBLIC \"-//X//X\" \"" + target + "\">", "<PMML>&x;</PMML>")},
      {"entity in an attribute: " + target, WithSubset(entity, "<PMML a=\"&x;\"/>")},
      {"entity inside an entity: " + target, WithSubset(entity + "<!ENTITY y \"&x;\">", "<PMML>&y;</PMML>")},
      {"parameter entity: " + target, WithSubset("<!ENTITY % x SYSTEM \"" + target + "\"> %x;", "<PMML/>")},
      {"parameter entity that declares one: " + target,
       WithSubset("<!ENTITY % x SYSTEM \"" + target + "\"><!ENTITY % y '%x;'> %y;", "<PMML>&z;</PMML>")},
  };
}

/// References to `target` that ordinary documents may hold as well: reading them opens nothing and is no
/// fault.
inline std::vector<HostileDocument> UnusedReferences(const std::string& target) {
  return {
      {"external document type: " + target, "<!DOCTYPE PMML SYSTEM \"" + target + "\"><PMML/>"},
      {"public document type: " + target, "<!DOCTYPE PMML PUBLIC \"-//X//X\" \"" + target + "\"><PMML/>"},
      {"entity that is not used: " + target, WithSubset("<!ENTITY x SYSTEM \"" + target + "\">", "<PMML/>")},
      {"unparsed entity: " + target,
       WithSubset("<!NOTATION n SYSTEM \"" + target + "\"><!ENTITY x SYSTEM \"" + target + "\" NDATA n>",
                  "<PMML/>")},
      {"style sheet: " + target, "<?xml-stylesheet href=\"" + target + "\" type=\"text/xsl\"?><PMML/>"},
      {"schema: " + target,
       "<PMML xmlns:xsi=\"http://www.w3.org/2001/XMLSchema-instance\" xsi:schemaLocation=\"x " + target +
           "\" xsi:noNamespaceSchemaLocation=\"" + target + "\"/>"},
      {"inclusion: " + target,
       "<PMML xmlns:xi=\"http://www.w3.org/2001/XInclude\"><xi:include href=\"" + target + "\"/></PMML>"},
  };
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_HOSTILEDOCUMENTS_H
