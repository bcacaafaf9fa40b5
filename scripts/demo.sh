#!/usr/bin/env bash
# The main job: installs what it needs, builds, and charts the bundled sample data: on a screen in
# the demo host's report window, without one (a server, CI) into a gallery folder of every chart.
set -euo pipefail
here=$(cd "$(dirname "$0")/.." && pwd)
bash "$here/scripts/deps.sh"
bash "$here/scripts/build.sh" "$here/build"
if [ -n "${DISPLAY:-}" ] || [ -n "${WAYLAND_DISPLAY:-}" ]; then
  exec "$here/build/bin/karstgraph-demo" "$@"
fi
gallery=${KG_GALLERY:-$here/gallery}
echo "No display: drawing every chart of the demo into $gallery"
exec "$here/build/bin/karstgraph" gallery "$gallery"
