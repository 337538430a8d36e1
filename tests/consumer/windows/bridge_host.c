/* A host without C++: opens the bridge of docs/windows.md by hand and scores one patient of examples/diabetes.
   usage: bridge_host BRIDGE MODEL */
#include <stdio.h>
#include <windows.h>

struct Scorer;
typedef struct Scorer *(*Open)(const char *, const char *, const char *const *, int, char *, int);
typedef int (*Score)(struct Scorer *, const double *, int, double *);
typedef void (*Close)(struct Scorer *);

int main(int argc, char **argv) {
  const char *const names[] = {"age", "sex", "bmi", "bp", "s1", "s2", "s3", "s4", "s5", "s6"};
  const double values[] = {59.0, 2.0, 32.1, 101.0, 157.0, 93.2, 38.0, 4.0, 4.8598, 87.0};
  char why[200] = "";
  double prediction = 0.0;
  HMODULE bridge = argc == 3 ? LoadLibraryA(argv[1]) : NULL;
  if (bridge == NULL) return 2;
  Open open = (Open)(void *)GetProcAddress(bridge, "OpenScorer");
  Score score = (Score)(void *)GetProcAddress(bridge, "ScoreNumbers");
  Close close = (Close)(void *)GetProcAddress(bridge, "CloseScorer");
  if (open == NULL || score == NULL || close == NULL) return 3;
  /* A document that is refused says why. */
  if (open(argv[2], "TreeModel", names, 10, why, sizeof why) != NULL) return 4;
  printf("%s\n", why);
  struct Scorer *scorer = open(argv[2], "RegressionModel", names, 10, why, sizeof why);
  if (scorer == NULL) return 5;
  if (score(scorer, values, 10, &prediction) != 0) return 6;
  printf("%.9g\n", prediction);
  close(scorer);
  return 0;
}
