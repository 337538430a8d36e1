# Writes a classification tree of the package rpart (Debian: r-cran-rpart) as a PMML TreeModel that treats missing
# values as rpart does: a split's surrogates are asked in their order, and when none knows, the case goes the way of
# most training cases. Where as many went either way it stays, for which such a node has a third child that says the
# same and is reached by default alone.

# The splits of a node: its own first, then its surrogates; those that rpart only lists as runners-up are left out.
splits_of <- function(fitted, row) {
  frame <- fitted$frame
  before <- frame[seq_len(row - 1), ]
  first <- sum((before$var != "<leaf>") * (1 + before$ncompete + before$nsurrogate)) + 1
  surrogates <- first + frame$ncompete[row] + seq_len(frame$nsurrogate[row])
  c(first, surrogates)
}

simple_predicate <- function(field, operator, value) sprintf(
  "<SimplePredicate field=%s operator=\"%s\" value=%s/>", quoted(field), operator, quoted(value))

set_predicate <- function(field, levels) {
  if (length(levels) == 1) return(simple_predicate(field, "equal", levels))
  # In the array's text a quote need not be escaped, and none of our levels has one.
  text <- gsub("<", "&lt;", gsub("&", "&amp;", levels, fixed = TRUE), fixed = TRUE)
  c(sprintf("<SimpleSetPredicate field=%s booleanOperator=\"isIn\">", quoted(field)),
    sprintf("  <Array n=\"%d\" type=\"string\">%s</Array>", length(levels), paste0("\"", text, "\"", collapse = " ")),
    "</SimpleSetPredicate>")
}

# What sends a case to the left or the right child. A level that no training case of the node had goes neither way.
split_predicate <- function(fitted, split, left) {
  field <- rownames(fitted$splits)[split]
  kind <- fitted$splits[split, "ncat"]
  index <- fitted$splits[split, "index"]
  if (abs(kind) == 1)
    return(simple_predicate(field, if ((kind < 0) == left) "lessThan" else "greaterOrEqual", number(index)))
  set_predicate(field, attr(fitted, "xlevels")[[field]][which(fitted$csplit[index, ] == if (left) 1 else 3)])
}

node_predicate <- function(fitted, row, left) {
  predicates <- lapply(splits_of(fitted, row), function(split) split_predicate(fitted, split, left))
  if (length(predicates) == 1) return(predicates[[1]])
  c("<CompoundPredicate booleanOperator=\"surrogate\">", paste0("  ", unlist(predicates)), "</CompoundPredicate>")
}

distribution_lines <- function(fitted, row) {
  categories <- attr(fitted, "ylevels")
  counts <- fitted$frame$yval2[row, 1 + seq_along(categories)]
  sprintf("<ScoreDistribution value=%s recordCount=\"%d\"/>", vapply(categories, quoted, ""), counts)
}

# A node of one of the tree's rows; default is the child that the undecided go to, if it has any.
node_element <- function(fitted, row, id, predicate, default = NULL, children = NULL) {
  frame <- fitted$frame
  score <- attr(fitted, "ylevels")[frame$yval[row]]
  default <- if (is.null(default)) "" else sprintf(" defaultChild=\"%s\"", default)
  c(sprintf("<Node id=\"%s\" score=%s recordCount=\"%d\"%s>", id, quoted(score), frame$n[row], default),
    paste0("  ", c(predicate, distribution_lines(fitted, row), children)),
    "</Node>")
}

# A node with all below it. Nodes are called by rpart's numbers: the children of n are 2n and 2n+1.
node_lines <- function(fitted, node, predicate) {
  row <- match(node, rownames(fitted$frame))
  stopifnot(!is.na(row))
  if (fitted$frame$var[row] == "<leaf>") return(node_element(fitted, row, node, predicate))
  children <- c(node_lines(fitted, 2 * node, node_predicate(fitted, row, TRUE)),
    node_lines(fitted, 2 * node + 1, node_predicate(fitted, row, FALSE)))
  sizes <- fitted$frame$n[match(2 * node + 0:1, rownames(fitted$frame))]
  if (sizes[1] != sizes[2])
    return(node_element(fitted, row, node, predicate, 2 * node + if (sizes[1] > sizes[2]) 0 else 1, children))
  stays <- paste0(node, "-stays")
  node_element(fitted, row, node, predicate, stays, c(children, node_element(fitted, row, stays, "<False/>")))
}

# cases: a data frame of factors and numbers, the target among them, that the tree was fitted to.
write_tree <- function(path, name, fitted, cases, target) {
  inputs <- setdiff(names(cases), target)
  fields <- unlist(lapply(names(cases), function(field)
    if (is.factor(cases[[field]])) categorical_field(field, levels(cases[[field]])) else continuous_field(field)))
  write_document(path, name, fields, length(cases), c(
    sprintf("  <TreeModel modelName=%s functionName=\"classification\" missingValueStrategy=\"defaultChild\">", quoted(name)),
    mining_schema(inputs, target), paste0("    ", node_lines(fitted, 1, "<True/>")), "  </TreeModel>"))
}

# rpart's own answers.
write_tree_answers <- function(path, fitted, cases) {
  chances <- predict(fitted, cases, type = "prob")
  best <- predict(fitted, cases, type = "class")
  columns <- lapply(colnames(chances), function(category) chances[, category])
  names(columns) <- paste0("probability_", colnames(chances))
  write_table(path, c(list(prediction = best, probability = chances[cbind(seq_along(best), as.integer(best))]), columns))
}
