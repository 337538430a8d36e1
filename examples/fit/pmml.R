# Writes a PMML 4.4 document, a RegressionModel above all, and the tables that go with an example.

# Reads back to the same double: 15 significant digits where they do, else 17.
number <- function(x) {
  short <- sprintf("%.15g", x)
  ifelse(as.numeric(short) == x, short, sprintf("%.17g", x))
}
quoted <- function(text) {
  text <- gsub("&", "&amp;", text, fixed = TRUE)
  text <- gsub("<", "&lt;", text, fixed = TRUE)
  paste0("\"", gsub("\"", "&quot;", text, fixed = TRUE), "\"")
}

categorical_field <- function(name, levels, optype = "categorical") c(
  sprintf("    <DataField name=%s optype=\"%s\" dataType=\"string\">", quoted(name), optype),
  sprintf("      <Value value=%s/>", vapply(levels, quoted, "")),
  "    </DataField>")
continuous_field <- function(name) sprintf("    <DataField name=%s optype=\"continuous\" dataType=\"double\"/>", quoted(name))

# A coefficient of a factor's level, of a number, or of a product of inputs.
level_term <- function(name, level, coefficient) sprintf(
  "      <CategoricalPredictor name=%s value=%s coefficient=\"%s\"/>", quoted(name), quoted(level), number(coefficient))
numeric_term <- function(name, coefficient) sprintf(
  "      <NumericPredictor name=%s coefficient=\"%s\"/>", quoted(name), number(coefficient))

table_lines <- function(intercept, terms, category = NULL) {
  target <- if (is.null(category)) "" else paste0(" targetCategory=", quoted(category))
  c(sprintf("    <RegressionTable intercept=\"%s\"%s>", number(intercept), target), terms, "    </RegressionTable>")
}

# A field of the mining schema; what takes the place of a missing value is the mean of a number and the mode of a text.
mining_field <- function(name, replacement = NULL) {
  if (is.null(replacement)) return(sprintf("      <MiningField name=%s/>", quoted(name)))
  is_number <- is.numeric(replacement)
  sprintf("      <MiningField name=%s missingValueReplacement=%s missingValueTreatment=\"%s\"/>", quoted(name),
    quoted(if (is_number) number(replacement) else replacement), if (is_number) "asMean" else "asMode")
}

mining_schema <- function(inputs, target, replacements = list()) c(
  "    <MiningSchema>",
  vapply(inputs, function(input) mining_field(input, replacements[[input]]), ""),
  sprintf("      <MiningField name=%s usageType=\"target\"/>", quoted(target)),
  "    </MiningSchema>")

# What the document is to tell of each case. Further attributes of a field stand behind its feature: value = "yes".
output_field <- function(name, feature, ...) {
  attributes <- c(...)
  more <- if (length(attributes) == 0) "" else paste0(" ", names(attributes), "=", vapply(attributes, quoted, ""), collapse = "")
  sprintf("      <OutputField name=%s feature=%s%s/>", quoted(name), quoted(feature), more)
}
output_lines <- function(...) c("    <Output>", ..., "    </Output>")

# What the target is when data are missing: a number, or the most probable category.
default_value <- function(value) sprintf("        <TargetValue defaultValue=\"%s\"/>", number(value))
prior_values <- function(categories, shown, priors) sprintf(
  "        <TargetValue value=%s displayValue=%s priorProbability=\"%s\"/>", vapply(categories, quoted, ""),
  vapply(shown, quoted, ""), number(priors))
targets_lines <- function(target, values) c(
  "    <Targets>", sprintf("      <Target field=%s>", quoted(target)), values, "      </Target>", "    </Targets>")

# fields: lines of DataField elements; count: how many fields they are; model: lines of the model element.
write_document <- function(path, name, fields, count, model) writeLines(c(
  "<?xml version=\"1.0\" encoding=\"UTF-8\"?>",
  "<PMML xmlns=\"http://www.dmg.org/PMML-4_4\" version=\"4.4\">",
  sprintf("  <Header description=%s/>", quoted(name)),
  sprintf("  <DataDictionary numberOfFields=\"%d\">", count), fields, "  </DataDictionary>",
  model, "</PMML>"), path)

# replacements: by the inputs' names; behind_schema: lines.
write_model <- function(path, name, fields, count, inputs, target, normalization, tables, func, replacements = list(),
                        behind_schema = NULL)
  write_document(path, name, fields, count, c(
    sprintf("  <RegressionModel modelName=%s functionName=\"%s\" normalizationMethod=\"%s\">", quoted(name), func, normalization),
    mining_schema(inputs, target, replacements), behind_schema, tables, "  </RegressionModel>"))

# Missing cells are empty.
cells_of <- function(column) {
  cells <- rep("", length(column))
  there <- !is.na(column)
  cells[there] <- if (is.numeric(column)) number(column[there]) else as.character(column[there])
  cells
}

# Columns of texts and numbers; texts are quoted only where they must be, which none of ours does.
write_table <- function(path, columns)
  writeLines(c(paste(names(columns), collapse = ","), do.call(paste, c(unname(lapply(columns, cells_of)), sep = ","))), path)
