# Turns a classification tree of the package rpart (Debian: r-cran-rpart) into the elements of tree.R, with its way of
# treating missing values: a split's surrogates are asked in their order, and when none knows, the case goes the way of
# most training cases. Where as many went either way it stays, for which such a node has a third child that says the
# same and is reached by default alone.
source("../fit/tree.R")

# The splits of a node: its own first, then its surrogates; those that rpart only lists as runners-up are left out.
splits_of <- function(fitted, row) {
  frame <- fitted$frame
  before <- frame[seq_len(row - 1), ]
  first <- sum((before$var != "<leaf>") * (1 + before$ncompete + before$nsurrogate)) + 1
  surrogates <- first + frame$ncompete[row] + seq_len(frame$nsurrogate[row])
  c(first, surrogates)
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
  compound_predicate("surrogate", unlist(predicates))
}

# Where the splits alone lead a case, as a row of the tree: a leaf, or the node whose split it has no value for. The tree
# must have been fitted without the use of surrogates.
rows_reached <- function(fitted, cases) {
  stopifnot(fitted$control$usesurrogate == 0)
  unname(rpart:::pred.rpart(fitted, rpart:::rpart.matrix(
    model.frame(delete.response(fitted$terms), cases, na.action = na.pass, xlev = attr(fitted, "xlevels")))))
}
node_numbers <- function(fitted) as.integer(rownames(fitted$frame))

# A node of one of the tree's rows; default is the child that the undecided go to, if it has any.
row_element <- function(fitted, row, id, predicate, default = NULL, children = NULL) {
  categories <- attr(fitted, "ylevels")
  counts <- fitted$frame$yval2[row, 1 + seq_along(categories)]
  node_element(id, categories[fitted$frame$yval[row]], predicate, categories, counts, default, children)
}

# A node with all below it. Nodes are called by rpart's numbers: the children of n are 2n and 2n+1.
node_lines <- function(fitted, node, predicate) {
  row <- match(node, rownames(fitted$frame))
  stopifnot(!is.na(row))
  if (fitted$frame$var[row] == "<leaf>") return(row_element(fitted, row, node, predicate))
  children <- c(node_lines(fitted, 2 * node, node_predicate(fitted, row, TRUE)),
    node_lines(fitted, 2 * node + 1, node_predicate(fitted, row, FALSE)))
  sizes <- fitted$frame$n[match(2 * node + 0:1, rownames(fitted$frame))]
  if (sizes[1] != sizes[2])
    return(row_element(fitted, row, node, predicate, 2 * node + if (sizes[1] > sizes[2]) 0 else 1, children))
  stays <- paste0(node, "-stays")
  row_element(fitted, row, node, predicate, stays, c(children, row_element(fitted, row, stays, "<False/>")))
}

# cases: the data frame that the tree was fitted to.
write_rpart <- function(path, name, fitted, cases, target)
  write_tree(path, name, cases, target, node_lines(fitted, 1, "<True/>"), " missingValueStrategy=\"defaultChild\"")
