#!/usr/bin/env Rscript
# Nine trees, each grown by rpart (Debian: r-cran-rpart) on its own sample of the diabetes tests of the package MASS,
# become one set of rules that vote: a leaf is a rule, the splits above it are the compound rules around it.
source("../fit/rpart.R")
library(rpart)

train <- MASS::Pima.tr
inputs <- setdiff(names(train), "type")
categories <- levels(train$type)
set.seed(768)
trees <- lapply(1:9, function(i) rpart(type ~ ., data = train[sample(nrow(train), replace = TRUE), ],
  control = rpart.control(cp = 0.005, minsplit = 12, maxsurrogate = 0, xval = 0)))

# The leaves of a tree in the order in which they stand in the document. A small leaf has less weight than its share of
# right answers, which is its confidence.
leaves_of <- function(tree) {
  fitted <- trees[[tree]]
  rows <- which(fitted$frame$var == "<leaf>")
  nodes <- as.integer(rownames(fitted$frame))[rows]
  rows <- rows[order(nodes / 2^floor(log2(nodes)))]
  count <- fitted$frame$n[rows]
  right <- apply(fitted$frame$yval2[rows, 1 + seq_along(categories)], 1, max)
  data.frame(tree = tree, node = as.integer(rownames(fitted$frame))[rows], count = count, right = right,
    category = fitted$frame$yval[rows], weight = (right + 1) / (count + 2), confidence = right / count)
}
rules <- do.call(rbind, lapply(seq_along(trees), leaves_of))

rule_lines <- function(tree, node, predicate) {
  fitted <- trees[[tree]]
  row <- match(node, rownames(fitted$frame))
  rule <- rules[rules$tree == tree & rules$node == node, ]
  if (nrow(rule) == 1) return(c(
    sprintf("<SimpleRule id=\"%d.%d\" score=%s recordCount=\"%d\" nbCorrect=\"%d\" confidence=\"%s\" weight=\"%s\">",
      tree, node, quoted(categories[rule$category]), as.integer(rule$count), as.integer(rule$right),
      number(rule$confidence), number(rule$weight)),
    paste0("  ", predicate), "</SimpleRule>"))
  split <- splits_of(fitted, row)
  inside <- c(rule_lines(tree, 2 * node, split_predicate(fitted, split, TRUE)),
    rule_lines(tree, 2 * node + 1, split_predicate(fitted, split, FALSE)))
  if (node == 1) inside else c("<CompoundRule>", paste0("  ", c(predicate, inside)), "</CompoundRule>")
}

usual <- table(train$type)
default <- names(usual)[which.max(usual)]
write_document("model.xml", "tests for diabetes, by the votes of nine trees",
  unlist(c(lapply(inputs, continuous_field), list(categorical_field("type", categories)))), length(train), c(
    "  <RuleSetModel modelName=\"diabetes in Pima women\" functionName=\"classification\">",
    mining_schema(inputs, "type"),
    sprintf("    <RuleSet recordCount=\"%d\" nbCorrect=\"%d\" defaultScore=%s defaultConfidence=\"%s\">", nrow(train),
      as.integer(max(usual)), quoted(default), number(max(usual) / nrow(train))),
    "      <RuleSelectionMethod criterion=\"weightedSum\"/>",
    sprintf("      <ScoreDistribution value=%s recordCount=\"%d\"/>", vapply(categories, quoted, ""), as.integer(usual)),
    paste0("      ", unlist(lapply(seq_along(trees), function(tree) rule_lines(tree, 1, "<True/>")))),
    "    </RuleSet>", "  </RuleSetModel>"))

# Women that no tree has seen: a third of them lacks a value, and of three only the age is known.
cases <- rbind(MASS::Pima.te, MASS::Pima.tr2[201:300, ], MASS::Pima.te[1:3, ])[, inputs]
cases[nrow(cases) - 0:2, setdiff(inputs, "age")] <- NA

# Which leaf a case falls into, by the splits alone; none where it lacks a value.
fires <- function(fitted, node) {
  if (node == 1) return(rep(TRUE, nrow(cases)))
  split <- splits_of(fitted, match(node %/% 2, rownames(fitted$frame)))
  value <- cases[[rownames(fitted$splits)[split]]]
  is_left <- (value < fitted$splits[split, "index"]) == (fitted$splits[split, "ncat"] < 0)
  fires(fitted, node %/% 2) & !is.na(value) & is_left == (node %% 2 == 0)
}
firing <- sapply(seq_len(nrow(rules)), function(i) fires(trees[[rules$tree[i]]], rules$node[i]))

# Where nothing is missing that is the leaf by which rpart itself predicts.
complete <- complete.cases(cases)
for (tree in seq_along(trees)) {
  leaf <- rules[rules$tree == tree, ]
  hit <- firing[complete, rules$tree == tree]
  stopifnot(rowSums(hit) == 1)
  matrix <- predict(trees[[tree]], cases[complete, ], type = "matrix")
  stopifnot(matrix[, 1] == hit %*% leaf$category, apply(matrix[, 1 + seq_along(categories)], 1, max) == hit %*% leaf$right)
}

votes <- sapply(seq_along(categories), function(category) firing %*% (rules$weight * (rules$category == category)))
certain <- sapply(seq_along(categories), function(category) firing %*% (rules$confidence * (rules$category == category)))
count <- rowSums(firing)
best <- max.col(votes, ties.method = "first")
shares <- votes / rowSums(votes)
confidence <- certain[cbind(seq_along(best), best)] / count
silent <- count == 0
best[silent] <- match(default, categories)
confidence[silent] <- max(usual) / nrow(train)
shares[silent, ] <- rep(as.vector(usual) / nrow(train), each = sum(silent))

write_table("data.csv", as.list(cases))
write_table("expected.csv", list(prediction = categories[best], probability = confidence, probability_No = shares[, 1],
  probability_Yes = shares[, 2]))
