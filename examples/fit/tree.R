# Writes a classification tree as a PMML 4.4 TreeModel.
source("../fit/pmml.R")

simple_predicate <- function(field, operator, value) sprintf(
  "<SimplePredicate field=%s operator=\"%s\" value=%s/>", quoted(field), operator, quoted(value))

set_predicate <- function(field, levels) {
  if (length(levels) == 1) return(simple_predicate(field, "equal", levels))
  # A quote inside a level would need a backslash; none of ours has one.
  text <- gsub("<", "&lt;", gsub("&", "&amp;", levels, fixed = TRUE), fixed = TRUE)
  c(sprintf("<SimpleSetPredicate field=%s booleanOperator=\"isIn\">", quoted(field)),
    sprintf("  <Array n=\"%d\" type=\"string\">%s</Array>", length(levels), paste0("\"", text, "\"", collapse = " ")),
    "</SimpleSetPredicate>")
}

compound_predicate <- function(operator, predicates) c(
  sprintf("<CompoundPredicate booleanOperator=\"%s\">", operator), paste0("  ", predicates), "</CompoundPredicate>")

# counts: the training cases of each category; default: the child that undecided cases go to, if any; children: lines.
node_element <- function(id, score, predicate, categories, counts, default = NULL, children = NULL) {
  default <- if (is.null(default)) "" else sprintf(" defaultChild=\"%s\"", default)
  distribution <- sprintf("<ScoreDistribution value=%s recordCount=\"%d\"/>", vapply(categories, quoted, ""), as.integer(counts))
  c(sprintf("<Node id=\"%s\" score=%s recordCount=\"%d\"%s>", id, quoted(score), as.integer(sum(counts)), default),
    paste0("  ", c(predicate, distribution, children)), "</Node>")
}

# cases: a data frame of factors and numbers, the target among them; root and behind_schema: lines; attributes: further ones of the model.
write_tree <- function(path, name, cases, target, root, attributes = "", behind_schema = NULL) {
  fields <- unlist(lapply(names(cases), function(field)
    if (is.factor(cases[[field]])) categorical_field(field, levels(cases[[field]])) else continuous_field(field)))
  write_document(path, name, fields, length(cases), c(
    sprintf("  <TreeModel modelName=%s functionName=\"classification\"%s>", quoted(name), attributes),
    mining_schema(setdiff(names(cases), target), target), behind_schema, paste0("    ", root), "  </TreeModel>"))
}

# The fitting program's own answers.
write_tree_answers <- function(path, best, chances) {
  columns <- lapply(colnames(chances), function(category) chances[, category])
  names(columns) <- paste0("probability_", colnames(chances))
  write_table(path, c(list(prediction = best, probability = chances[cbind(seq_along(best), as.integer(best))]), columns))
}
