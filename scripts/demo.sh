#!/usr/bin/env bash
# The main job: installs what it needs, builds, and charts the bundled sample data.
set -euo pipefail
here=$(cd "$(dirname "$0")/.." && pwd)
bash "$here/scripts/deps.sh"
bash "$here/scripts/build.sh" "$here/build"
exec "$here/build/bin/karstgraph" describe
