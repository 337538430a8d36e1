# What the scripts for Linux and for Windows share; included after $work is set.

# The fitting program's answer for the flower that examples/host scores, to six digits.
expected="versicolor 0.859902"

fail() { echo "$*"; exit 1; }
passed() { echo "passed: $*"; }
quiet() { "$@" >"$work.log" 2>&1 || { cat "$work.log"; exit 1; }; }

check() {  # check WHAT COMMAND...: the host's answer must be the fitting program's
  local what=$1 answer; shift
  answer=$("$@" | tr -d '\r')
  [ "$answer" = "$expected" ] || fail "$what: expected \"$expected\", got \"$answer\""
  passed "$what: $answer"
}

# project NAME SOURCE-FOLDER OPTION...: configures and builds a stranger's project in $work/NAME
project() {
  local name=$1 source=$2; shift 2
  quiet cmake -G Ninja -S "$source" -B "$work/$name" -DCMAKE_BUILD_TYPE=Release "$@"
  quiet cmake --build "$work/$name" --parallel "$(nproc)"
}

# make_plain_plugin OPTION...: a model kind in a folder that holds nothing else of this project; it is built in
# $work/plain, its document is $work/plain.xml and the list of models for it $work/names.txt.
make_plain_plugin() {
  local sources=$work/plain_sources
  mkdir -p "$sources/tests/model/plugins"
  cp tests/consumer/plugin/CMakeLists.txt "$sources/"
  cp tests/model/plugins/StubModel.h tests/model/plugins/PlainTranslator.cpp "$sources/tests/model/plugins/"
  project plain "$sources" "$@"
  echo '<PMML version="4.4"><PlainModel/></PMML>' >"$work/plain.xml"
  echo PlainModel >"$work/names.txt"
}
