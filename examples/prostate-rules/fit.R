#!/usr/bin/env Rscript
# Grows a tree with rpart on its own data of 146 patients with cancer of the prostate, and writes each leaf as a rule. The
# document tells which rule decided, what it says and how sure it is.
source("../fit/rpart.R")
library(rpart)

patients <- stagec[, c("age", "eet", "g2", "grade", "gleason", "ploidy")]
inputs <- names(patients)
patients$progressed <- factor(ifelse(stagec$pgstat == 1, "yes", "no"))
categories <- levels(patients$progressed)
fitted <- rpart(progressed ~ ., data = patients,
  control = rpart.control(cp = 0.005, minsplit = 10, maxsurrogate = 0, usesurrogate = 0))

path_lines <- function(node) {
  if (node == 1) return(NULL)
  split <- splits_of(fitted, match(node %/% 2, node_numbers(fitted)))
  c(path_lines(node %/% 2), split_predicate(fitted, split, node %% 2 == 0))
}
leaves <- which(fitted$frame$var == "<leaf>")
count <- fitted$frame$n
right <- apply(fitted$frame$yval2[, 1 + seq_along(categories)], 1, max)
rule_name <- paste("leaf", node_numbers(fitted))
rule_lines <- function(row) c(
  sprintf("<SimpleRule id=%s score=%s recordCount=\"%d\" nbCorrect=\"%d\" confidence=\"%s\">", quoted(rule_name[row]),
    quoted(categories[fitted$frame$yval[row]]), as.integer(count[row]), as.integer(right[row]), number(right[row] / count[row])),
  paste0("  ", compound_predicate("and", path_lines(node_numbers(fitted)[row]))), "</SimpleRule>")

fields <- lapply(names(patients), function(name)
  if (is.factor(patients[[name]])) categorical_field(name, levels(patients[[name]])) else continuous_field(name))
default <- categories[fitted$frame$yval[1]]
write_document("model.xml", "progress of cancer of the prostate", unlist(fields), length(patients), c(
  "  <RuleSetModel modelName=\"progress of cancer of the prostate\" functionName=\"classification\">",
  mining_schema(inputs, "progressed"),
  output_lines(output_field("progress", "predictedValue"), output_field("sureness", "probability"),
    output_field("entity", "entityId"), output_field("affinity", "entityAffinity"),
    output_field("rule", "ruleValue", ruleFeature = "ruleId"), output_field("rule_says", "ruleValue"),
    output_field("rule_confidence", "ruleValue", ruleFeature = "confidence")),
  sprintf("    <RuleSet recordCount=\"%d\" nbCorrect=\"%d\" defaultScore=%s defaultConfidence=\"%s\">", nrow(patients),
    as.integer(right[1]), quoted(default), number(right[1] / count[1])),
  "      <RuleSelectionMethod criterion=\"firstHit\"/>",
  paste0("      ", unlist(lapply(leaves, rule_lines))), "    </RuleSet>", "  </RuleSetModel>"))
write_table("data.csv", as.list(patients))

row <- rows_reached(fitted, patients)
silent <- fitted$frame$var[row] != "<leaf>"
stopifnot(any(silent), categories[fitted$frame$yval[row]] == predict(fitted, patients, type = "class"))
best <- ifelse(silent, default, categories[fitted$frame$yval[row]])
sureness <- ifelse(silent, right[1] / count[1], right[row] / count[row])
of_rule <- function(values) ifelse(silent, NA, values)
write_table("outputs.csv", list(progress = best, sureness = sureness, entity = of_rule(rule_name[row]),
  affinity = of_rule(sureness), rule = of_rule(rule_name[row]), rule_says = of_rule(best),
  rule_confidence = of_rule(sureness)))
