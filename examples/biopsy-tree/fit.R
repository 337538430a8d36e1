#!/usr/bin/env Rscript
# Fits a classification tree with rpart to the biopsies of breast tumours of the package MASS (Debian: r-cran-mass). The
# document tells each case's leaf and probabilities; where a split lacks its value, the prior probabilities predict.
source("../fit/rpart.R")
library(rpart)

measures <- c(V1 = "clump_thickness", V2 = "cell_size", V3 = "cell_shape", V4 = "adhesion", V5 = "epithelial_size",
  V6 = "bare_nuclei", V7 = "chromatin", V8 = "nucleoli", V9 = "mitoses")
cases <- MASS::biopsy[, c(names(measures), "class")]
names(cases) <- c(measures, "class")
categories <- levels(cases$class)

fitted <- rpart(class ~ ., data = cases, control = rpart.control(cp = 0.001, minsplit = 10, maxsurrogate = 0, usesurrogate = 0))
priors <- fitted$parms$prior

# Beside the bare nuclei, which sixteen biopsies lack, we forget the cells' size in every tenth.
set.seed(1992)
cases$cell_size[sample(nrow(cases), nrow(cases) %/% 10)] <- NA

tree_lines <- function(node, predicate) {
  row <- match(node, node_numbers(fitted))
  if (fitted$frame$var[row] == "<leaf>") return(row_element(fitted, row, node, predicate))
  row_element(fitted, row, node, predicate, NULL, c(tree_lines(2 * node, node_predicate(fitted, row, TRUE)),
    tree_lines(2 * node + 1, node_predicate(fitted, row, FALSE))))
}
shown <- c("a benign tumour", "a malignant tumour")
write_tree("model.xml", "kind of a breast tumour by its biopsy", cases, "class", tree_lines(1, "<True/>"),
  " missingValueStrategy=\"nullPrediction\"", c(
    output_lines(output_field("kind", "predictedValue"), output_field("shown_as", "predictedDisplayValue"),
      output_field("certainty", "probability"),
      vapply(categories, function(category) output_field(paste0("chance_", category), "probability", value = category), ""),
      output_field("leaf", "entityId"), output_field("warning", "warning", dataType = "integer")),
    targets_lines("class", prior_values(categories, shown, priors))))
write_table("data.csv", as.list(cases))

row <- rows_reached(fitted, cases)
stuck <- fitted$frame$var[row] != "<leaf>"
chances <- predict(fitted, cases, type = "prob")
chances[stuck, ] <- rep(priors, each = sum(stuck))
best <- max.col(chances, ties.method = "first")
stopifnot(any(stuck), categories[best[!stuck]] == predict(fitted, cases, type = "class")[!stuck])
write_table("outputs.csv", list(kind = categories[best], shown_as = shown[best], certainty = apply(chances, 1, max),
  chance_benign = chances[, 1], chance_malignant = chances[, 2],
  leaf = ifelse(stuck, NA, as.character(node_numbers(fitted)[row])), warning = ifelse(stuck, 90027, NA)))
