#!/usr/bin/env Rscript
# Fits a conditional inference tree of the package partykit (Debian: r-cran-partykit), which splits categories all ways,
# to what 2,431 Chileans said in 1988 of the coming plebiscite (the package carData, Debian: r-cran-cardata).
source("../fit/tree.R")
suppressMessages(library(partykit))

voters <- na.omit(carData::Chile)[, c("region", "sex", "age", "education", "statusquo", "vote")]
fitted <- ctree(vote ~ ., data = voters, control = ctree_control(multiway = TRUE, alpha = 0.2, minsplit = 20, minbucket = 7))
answers <- fitted$fitted[["(response)"]]

# What sends a case to a child of a split.
condition <- function(split, child) {
  field <- names(fitted$data)[varid_split(split)]
  breaks <- breaks_split(split)
  if (is.null(breaks)) return(set_predicate(field, levels(voters[[field]])[which(index_split(split) == child)]))
  simple_predicate(field, if (child == 1) "lessOrEqual" else "greaterThan", number(breaks))
}

# A node's children, each with its conditions. Cuts of one number below each other are one split with intervals.
children_of <- function(node) {
  split <- split_node(node)
  of_child <- function(i) {
    child <- kids_node(node)[[i]]
    here <- list(condition(split, i))
    below <- if (is.terminal(child)) NULL else split_node(child)
    if (is.null(below) || is.null(breaks_split(split)) || varid_split(below) != varid_split(split))
      return(list(list(node = child, conditions = here)))
    lapply(children_of(child), function(part) list(node = part$node, conditions = c(here, part$conditions)))
  }
  do.call(c, lapply(seq_along(kids_node(node)), of_child))
}

node_lines <- function(node, predicate) {
  counts <- table(answers[fitted$fitted[["(fitted)"]] %in% nodeids(fitted, id_node(node), terminal = TRUE)])
  children <- if (is.terminal(node)) NULL else unlist(lapply(children_of(node), function(child) node_lines(child$node,
    if (length(child$conditions) == 1) child$conditions[[1]] else compound_predicate("and", unlist(child$conditions)))))
  node_element(id_node(node), names(which.max(counts)), predicate, names(counts), counts, children = children)
}

write_tree("model.xml", "who will vote how in Chile's plebiscite", voters, "vote", node_lines(node_party(fitted), "<True/>"))

# Every sixth is enough to meet each leaf.
cases <- voters[seq(1, nrow(voters), 6), ]
write_table("data.csv", as.list(cases))
write_tree_answers("expected.csv", predict(fitted, cases, type = "response"), predict(fitted, cases, type = "prob"))
