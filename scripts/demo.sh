#!/usr/bin/env bash
# Builds Telvio, starts the simulated meter on a pseudo-terminal and starts Telvio pointed at it,
# with settings in a folder of its own (a user's real settings stay untouched).
#   bash scripts/demo.sh [--profile NAME] [--screenshot FILE]
# Profiles: plain k50 k50v3 lxt k51 k5ac k5acmv k5ad k5gj k5ah percent-log percent-nolog qr32
# zum410 qr34. With --screenshot, runs under Xvfb, waits until the meter is detected, writes a
# PNG of the window and exits.
set -euo pipefail
top="$(cd "$(dirname "$0")/.." && pwd)"
cd "$top"

profile="percent-log"
screenshot=""
while [ $# -gt 0 ]; do
    case "$1" in
        --profile) profile="$2"; shift 2 ;;
        --screenshot) screenshot="$2"; shift 2 ;;
        *) echo "usage: $0 [--profile NAME] [--screenshot FILE]" >&2; exit 2 ;;
    esac
done
case "$screenshot" in ""|/*) ;; *) screenshot="$PWD/$screenshot" ;; esac

bash scripts/deps.sh
bash scripts/build.sh build --target telvio --target metersim_exe

demo="$top/build/demo"
rm -rf "$demo"
mkdir -p "$demo/config/Telvio"
pids=()
cleanup() { for p in "${pids[@]}"; do kill "$p" 2>/dev/null || true; done; }
trap cleanup EXIT

./build/tools/metersim/metersim --profile "$profile" --log 25 > "$demo/meter.out" &
pids+=($!)
for _ in $(seq 50); do [ -s "$demo/meter.out" ] && break; sleep 0.1; done
port="$(head -n 1 "$demo/meter.out")"
[ -n "$port" ] || { echo "the simulated meter did not start" >&2; exit 1; }
echo "Simulated meter ($profile) on $port"

# Settings of the demo: the meter's port, and the first start already done.
cat > "$demo/config/Telvio/Telvio.conf" <<CONF
[Settings]
COM=$port
Baud=9600
CONF
printf '[Settings]\nFirstRun=False\n' > "$demo/config/Telvio/telvio.conf"
export XDG_CONFIG_HOME="$demo/config"

if [ -z "$screenshot" ]; then
    if [ -z "${DISPLAY:-}${WAYLAND_DISPLAY:-}" ]; then
        echo "No display here: use  bash scripts/demo.sh --screenshot demo.png" >&2
        exit 1
    fi
    ./build/telvio
    exit 0
fi

display=":$((90 + RANDOM % 9))"
Xvfb "$display" -screen 0 1280x800x24 -nolisten tcp > "$demo/xvfb.log" 2>&1 &
pids+=($!)
for _ in $(seq 50); do [ -e "/tmp/.X11-unix/X${display#:}" ] && break; sleep 0.1; done
export DISPLAY="$display"
QT_QPA_PLATFORM=xcb ./build/telvio > "$demo/telvio.log" 2>&1 &
pids+=($!)
# Detected once the meter has answered the status query and the window has settled.
for _ in $(seq 100); do
    grep -q "Telvio" <(xdotool search --name "Telvio" getwindowname 2>/dev/null || true) && break
    sleep 0.1
done
sleep 4
import -window root "$screenshot"
echo "Screenshot written to $screenshot"
