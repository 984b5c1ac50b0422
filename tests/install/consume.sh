#!/usr/bin/env bash
# Installs the project into a temporary prefix, builds a small host application against the
# installed package and runs it; then runs the installed program moved elsewhere, which must find
# its resources beside itself. Usage: tests/install/consume.sh [BUILD_DIR]
set -euo pipefail
here="$(cd "$(dirname "$0")" && pwd)"
top="$(cd "$here/../.." && pwd)"
build="${1:-$top/build}"
work="$(mktemp -d)"
trap 'rm -rf "$work"' EXIT

cmake --install "$build" --prefix "$work/prefix" >/dev/null
cmake -S "$here/consumer" -B "$work/consumer" -DCMAKE_PREFIX_PATH="$work/prefix" >/dev/null
cmake --build "$work/consumer" -j 2 >/dev/null
"$work/consumer/consumer" | grep -q 'check "checkViewFrame_dialog" @0,1 title="Display the view frame" \[x\]' || {
  echo "consumer: the page was not shown" >&2
  exit 1
}

# A relocated installation still finds its catalogs without any environment.
mv "$work/prefix" "$work/moved"
version="$(env -u ZEP_RESOURCES "$work/moved/bin/drafting-options" --version)"
grep -qx "resources: $work/moved/share/drafting-options" <<<"$version" || {
  echo "the moved program did not find its resources beside itself: $version" >&2
  exit 1
}
env -u ZEP_RESOURCES HOME="$work" "$work/moved/bin/drafting-options" --settings "$work/s.json" show general |
  grep -q "Display the view frame"
echo "install and consume: ok"
