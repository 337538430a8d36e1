#include "apps/kestrel/DescribeCommand.h"

#include <algorithm>
#include <cstdio>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "apps/kestrel/ExpressionText.h"
#include "apps/kestrel/LoadedModel.h"
#include "apps/kestrel/ModelDescription.h"
#include "apps/kestrel/OutputFile.h"
#include "apps/kestrel/ShownText.h"

namespace kestrel_program {
namespace {

/// Keys in the order in which they are put in, because people read them.
using Json = nlohmann::ordered_json;

Json ToJson(const FieldDescription& field) {
  Json object;
  object["name"] = field.name;
  if (!field.label.empty()) object["label"] = field.label;
  object["type"] = field.type;
  object["level"] = field.level;
  if (field.expression.empty()) {
    object["role"] = field.role;
    object["read"] = field.is_read;
  } else {
    object["expression"] = field.expression;
  }
  object["categories"] = Json::array();
  for (const FieldDescription::Category& category : field.categories) {
    Json entry;
    entry["value"] = category.value;
    if (!category.label.empty()) entry["label"] = category.label;
    object["categories"].push_back(entry);
  }
  object["missing"] = field.missing;
  return object;
}

Json ToJson(const OutputDescription& field) {
  Json object;
  object["name"] = field.name;
  if (!field.label.empty()) object["label"] = field.label;
  object["type"] = field.type;
  object["feature"] = field.feature.empty() ? Json() : Json(field.feature);
  if (!field.value.empty()) object["value"] = field.value;
  return object;
}

Json ToJson(const ModelDescription& model) {
  Json object;
  object["kind"] = model.kind.empty() ? Json() : Json(model.kind);
  if (model.is_legacy) object["format"] = "vexa-ml";
  object["version"] = model.version;
  object["target"] = model.has_target ? ToJson(model.target) : Json();
  object["inputs"] = Json::array();
  for (const FieldDescription& field : model.inputs)
    object["inputs"].push_back(ToJson(field));
  object["derived"] = Json::array();
  for (const FieldDescription& field : model.derived)
    object["derived"].push_back(ToJson(field));
  object["outputs"] = Json::array();
  for (const OutputDescription& field : model.outputs)
    object["outputs"].push_back(ToJson(field));
  return object;
}

using TableLine = std::vector<std::string>;

/// A line stays readable; who needs them all takes the other form.
std::string Join(const std::vector<std::string>& texts, std::size_t most) {
  std::string joined;
  for (std::size_t i = 0; i < texts.size() && i < most; ++i)
    joined += (i == 0 ? "" : ", ") + ShownText(texts[i]);
  if (texts.size() > most) joined += " and " + std::to_string(texts.size() - most) + " more (see --json)";
  return joined.empty() ? "-" : joined;
}

TableLine ToLine(const FieldDescription& field, bool shows_what_is_read = true) {
  constexpr std::size_t kMostMissing = 5;
  constexpr std::size_t kMostCategories = 20;
  std::vector<std::string> categories;
  for (const FieldDescription::Category& category : field.categories) {
    categories.push_back(category.label.empty() ? category.value
                                                : category.value + " (" + category.label + ")");
  }
  const bool is_idle = shows_what_is_read && !field.is_read && field.role != "target";
  return {ShownText(field.name),
          field.type,
          field.level,
          field.role + (is_idle ? " (not read)" : ""),
          Join(field.missing, kMostMissing),
          Join(categories, kMostCategories)};
}

/// Characters, not bytes: names need not be ASCII.
std::size_t WidthOf(const std::string& text) {
  return static_cast<std::size_t>(std::count_if(
      text.begin(), text.end(), [](char c) { return (static_cast<unsigned char>(c) & 0xC0u) != 0x80u; }));
}

void AppendAligned(const std::vector<TableLine>& lines, std::string& out) {
  std::vector<std::size_t> widths(lines.front().size());
  for (const TableLine& line : lines) {
    for (std::size_t i = 0; i < line.size(); ++i)
      widths[i] = std::max(widths[i], WidthOf(line[i]));
  }
  for (const TableLine& line : lines) {
    out += "  ";
    for (std::size_t i = 0; i < line.size(); ++i) {
      out += line[i];
      if (i + 1 < line.size()) out.append(widths[i] - WidthOf(line[i]) + 2, ' ');
    }
    out += '\n';
  }
}

std::string KindText(const ModelDescription& model) {
  if (model.is_legacy) return "none, the dictionary of a document in the older format (vexa-ml) alone";
  return model.kind.empty() ? "none, derived fields alone" : model.kind;
}

void AppendDerived(const std::vector<FieldDescription>& derived, std::string& out) {
  if (derived.empty()) return;
  out += "derived fields: " + std::to_string(derived.size()) + "\n";
  std::vector<TableLine> lines = {{"name", "type", "level", "expression"}};
  for (const FieldDescription& field : derived)
    lines.push_back({ShownText(field.name), field.type, field.level, field.expression});
  AppendAligned(lines, out);
}

void AppendOutputs(const std::vector<OutputDescription>& outputs, std::string& out) {
  if (outputs.empty()) return;
  const auto shown = [](const std::string& text) {
    return text.empty() ? std::string("-") : ShownText(text);
  };
  out += "output fields: " + std::to_string(outputs.size()) + "\n";
  std::vector<TableLine> lines = {{"name", "type", "feature", "value", "label"}};
  for (const OutputDescription& field : outputs)
    lines.push_back(
        {ShownText(field.name), field.type, shown(field.feature), shown(field.value), shown(field.label)});
  AppendAligned(lines, out);
}

void AppendText(const ModelDescription& model, std::string& out) {
  out += "kind:    " + KindText(model) + "\n";
  out += "version: " + (model.version.empty() ? std::string("-") : ShownText(model.version)) + "\n";
  const TableLine kHeading = {"name", "type", "level", "role", "missing values", "categories"};
  out += "target:\n";
  if (model.has_target) {
    AppendAligned({kHeading, ToLine(model.target)}, out);
  } else {
    out += "  none\n";
  }
  out += "inputs: " + std::to_string(model.inputs.size()) + "\n";
  if (!model.inputs.empty()) {
    std::vector<TableLine> lines = {kHeading};
    for (const FieldDescription& field : model.inputs)
      lines.push_back(ToLine(field, !model.is_legacy));
    AppendAligned(lines, out);
  }
  AppendDerived(model.derived, out);
  AppendOutputs(model.outputs, out);
}

ModelDescription DescribeDocument(const LoadedDocument& loaded, const ExpressionText& expressions) {
  if (loaded.model != nullptr) return ModelDescription(*loaded.model, expressions);
  if (loaded.legacy != nullptr) return ModelDescription(*loaded.legacy);
  return ModelDescription(*loaded.fields.dictionary, *loaded.fields.derived, expressions);
}

}  // namespace

ExitCode Describe(const std::string& model, const std::string& names_file, bool as_json) {
  // A line stays readable; who needs it all takes the other form.
  constexpr std::size_t kMostRows = 10;
  const LoadedDocument loaded = LoadDocument(model, names_file);
  const ExpressionText expressions = as_json ? ExpressionText() : ExpressionText::Short(kMostRows);
  const ModelDescription description = DescribeDocument(loaded, expressions);
  OutputFile output("-");
  if (as_json) {
    output.GetBuffer() += ToJson(description).dump(2, ' ', false, Json::error_handler_t::replace) + "\n";
  } else {
    AppendText(description, output.GetBuffer());
  }
  output.Finish();
  if (!loaded.refusal.empty())
    std::fprintf(stderr, "kestrel: the model cannot be scored: %s\n", loaded.refusal.c_str());
  return kDone;
}

}  // namespace kestrel_program
