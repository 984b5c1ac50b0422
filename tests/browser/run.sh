#!/usr/bin/env bash
# End to end in a real browser: drafting-options serve on fresh settings files, its page driven
# by headless Chromium through Selenium (tests/browser/live_page.py). Installs its Debian
# packages first (scripts/install-browser-deps). Screenshots go to BUILD/screenshots.
# Usage: tests/browser/run.sh [BUILD]   (BUILD: the build folder holding app/drafting-options)
set -euo pipefail
cd "$(dirname "$0")/../.."
build=${1:-build}
binary=$build/app/drafting-options
[ -x "$binary" ] || { echo "error: no $binary: build first (make test)" >&2; exit 1; }
./scripts/install-browser-deps
shots=$build/screenshots
mkdir -p "$shots"
work=$(mktemp -d)
server=""
cleanup() {
  [ -n "$server" ] && kill "$server" 2>/dev/null || true
  rm -rf "$work"
}
trap cleanup EXIT
settings=$work/settings.json
admin=$work/admin.json
files=(--settings "$settings" --admin "$admin")

# The administrator locks the snap: its padlock is closed on the grid page.
"$binary" "${files[@]}" lock grid checkSnap off >/dev/null

"$binary" "${files[@]}" serve --no-open >"$work/serve.out" 2>"$work/serve.err" &
server=$!
url=""
for _ in $(seq 1 100); do
  url=$(grep -o 'http://127\.0\.0\.1:[0-9]*/?token=[0-9a-f]*' "$work/serve.out" || true)
  [ -n "$url" ] && break
  kill -0 "$server" 2>/dev/null || { cat "$work/serve.err" >&2; exit 1; }
  sleep 0.1
done
[ -n "$url" ] || { echo "error: the server printed no address" >&2; exit 1; }

# Debian's Python sees Debian's python3-selenium (a python3 earlier on PATH may not).
/usr/bin/python3 tests/browser/live_page.py "$url" "$binary" "$settings" "$admin" "$shots"

kill -TERM "$server"
status=0
wait "$server" || status=$?
server=""
[ "$status" -eq 0 ] || { echo "error: serve ended with $status after SIGTERM" >&2; exit 1; }
grep -q "Stopped." "$work/serve.out" || { echo "error: serve did not say it stopped" >&2; exit 1; }
echo "browser test passed; screenshots in $shots"
