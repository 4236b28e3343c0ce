#!/usr/bin/env bash
# bench/beside_gnote.sh [build dir] [memo count] [runs]: the cold start of memo on a real X11 window beside
# Gnote, the desktop's own notes app, holding the same memos as its note files.
#
# Both run in a private HOME and XDG folders, on a private Xvfb with openbox, each under dbus-run-session.
# The store is filled by memo_seed (default 10,000 memos); every memo that is not deleted is also written as
# one Gnote note file (XML) under $XDG_DATA_HOME/gnote/. Each run is timed from the exec of the program to its
# first visible window (xdotool search --sync --onlyvisible); the peak memory is the program's VmHWM at that
# moment. Prints the medians of the runs (default 3) and memo's share of Gnote's time and memory.
#
# Gnote is installed here when missing (apt-get, as root or through sudo): the benchmark is no part of the
# build or of CI, so scripts/deps does not install it. Xvfb, openbox and xdotool come from scripts/deps.
set -euo pipefail
top=$(cd "$(dirname "$0")/.." && pwd)
build=$(cd "${1:-$top/build}" && pwd)
count=${2:-10000}
runs=${3:-3}

if ! command -v gnote >/dev/null; then
	echo "installing gnote" >&2
	if [ "$(id -u)" = 0 ]; then
		DEBIAN_FRONTEND=noninteractive apt-get install -y gnote >/dev/null
	else
		sudo DEBIAN_FRONTEND=noninteractive apt-get install -y gnote >/dev/null
	fi
fi
for tool in Xvfb openbox xdotool dbus-run-session setsid python3; do
	command -v "$tool" >/dev/null || { echo "beside_gnote: $tool is missing (scripts/deps installs it)" >&2; exit 3; }
done
for file in "$build/app/bin/memo" "$build/tests/helpers/memo_seed"; do
	[ -x "$file" ] || { echo "beside_gnote: $file is missing; build first" >&2; exit 3; }
done

work=$(mktemp -d /tmp/memo-beside-gnote-XXXXXX)
xvfb="" wm="" leader=""
cleanup()
{
	# Each was started by this script in a process group of its own.
	for pid in $leader $wm $xvfb; do
		kill -TERM -- "-$pid" 2>/dev/null || kill -TERM "$pid" 2>/dev/null || true
	done
	wait 2>/dev/null || true
	rm -rf "$work"
}
trap cleanup EXIT

export HOME=$work/home XDG_DATA_HOME=$work/data XDG_CONFIG_HOME=$work/config XDG_CACHE_HOME=$work/cache
export XDG_RUNTIME_DIR=$work/run TIZEN_APP_ROOT=$work/memo/app TIZEN_VCONF_DIR=$work/memo/vconf
mkdir -p "$HOME" "$XDG_DATA_HOME/gnote" "$XDG_CONFIG_HOME" "$XDG_CACHE_HOME" "$XDG_RUNTIME_DIR" "$TIZEN_APP_ROOT"
chmod 700 "$XDG_RUNTIME_DIR"
unset DBUS_SESSION_BUS_ADDRESS WAYLAND_DISPLAY DLOG_LEVEL

echo "filling the stores with $count memos" >&2
TIZEN_APP_ID=com.veltron.memo TIZEN_APP_RES_DIR=$build/app/res/ ELM_ENGINE=buffer ECORE_NO_SYSTEM_MODULES=1 \
	"$build/tests/helpers/memo_seed" fill "$count" >"$work/seed.log" 2>&1
# One note file per memo: its title (or its first words) as the note's title, then its text. Titles that
# repeat get a number, as Gnote numbers its own new notes.
python3 - "$TIZEN_APP_ROOT/data/memo.db" "$XDG_DATA_HOME/gnote" <<'EOF'
import datetime, sqlite3, sys, uuid
from xml.sax.saxutils import escape

db, folder = sys.argv[1], sys.argv[2]
rows = sqlite3.connect(db).execute(
    "SELECT title, strippedContent, createdAt, lastModifiedAt FROM memo WHERE isDeleted = 0 AND isQuick = 0")
seen = {}
for title, text, created, modified in rows:
    text = text or ""
    title = (title or " ".join(text.split()[:4]) or "Memo").strip()
    seen[title] = seen.get(title, 0) + 1
    if seen[title] > 1:
        title = "%s (%d)" % (title, seen[title])
    stamp = lambda ms: datetime.datetime.fromtimestamp(ms / 1000, datetime.timezone.utc).strftime(
        "%Y-%m-%dT%H:%M:%S.0000000+00:00")
    with open("%s/%s.note" % (folder, uuid.uuid4()), "w", encoding="utf-8") as note:
        note.write('<?xml version="1.0" encoding="utf-8"?>\n'
                   '<note version="0.3" xmlns:link="http://beatniksoftware.com/tomboy/link" '
                   'xmlns:size="http://beatniksoftware.com/tomboy/size" xmlns="http://beatniksoftware.com/tomboy">\n'
                   '  <title>%s</title>\n'
                   '  <text xml:space="preserve"><note-content version="0.1">%s\n\n%s</note-content></text>\n'
                   '  <last-change-date>%s</last-change-date>\n'
                   '  <last-metadata-change-date>%s</last-metadata-change-date>\n'
                   '  <create-date>%s</create-date>\n'
                   '  <cursor-position>0</cursor-position>\n  <selection-bound-position>-1</selection-bound-position>\n'
                   '  <width>450</width>\n  <height>360</height>\n  <x>0</x>\n  <y>0</y>\n'
                   '  <open-on-startup>False</open-on-startup>\n</note>\n'
                   % (escape(title), escape(title), escape(text), stamp(modified), stamp(modified), stamp(created)))
EOF
notes=$(find "$XDG_DATA_HOME/gnote" -name '*.note' | wc -l)

setsid Xvfb -displayfd 3 -screen 0 1280x1024x24 -nolisten tcp 3>"$work/display" >"$work/xvfb.log" 2>&1 &
xvfb=$!
for _ in $(seq 50); do [ -s "$work/display" ] && break; sleep 0.1; done
export DISPLAY=:$(cat "$work/display")
setsid openbox >"$work/openbox.log" 2>&1 &
wm=$!
sleep 1

# run <name> <program name> <xdotool search arguments> -- <command...>: one cold start; appends "ms KiB" to
# $work/<name>.times.
run()
{
	local name=$1 program=$2 search=$3
	shift 4
	local start end app hwm
	start=$(date +%s%N)
	setsid dbus-run-session -- "$@" >>"$work/$name.log" 2>&1 &
	leader=$!
	# shellcheck disable=SC2086
	if ! timeout 300 xdotool search --sync --onlyvisible $search >/dev/null; then
		echo "beside_gnote: no window of $name" >&2
		exit 4
	fi
	end=$(date +%s%N)
	app=$(pgrep -P "$leader" -x "$program" | head -1)
	hwm=$(awk '/^VmHWM/ {print $2}' "/proc/$app/status")
	kill -TERM -- "-$leader" 2>/dev/null || true
	wait "$leader" 2>/dev/null || true
	leader=""
	# Nothing of this run may be left for the next one to find.
	for _ in $(seq 50); do
		# shellcheck disable=SC2086
		[ -z "$(xdotool search --onlyvisible $search 2>/dev/null)" ] && break
		sleep 0.1
	done
	echo "$(((end - start) / 1000000)) $hwm" >>"$work/$name.times"
}

# measure <name> <run arguments...>: the runs; prints the median time (ms) and the median peak (KiB).
measure()
{
	local name=$1
	shift
	for _ in $(seq "$runs"); do
		run "$name" "$@"
	done
	for column in 1 2; do
		cut -d' ' -f"$column" "$work/$name.times" | sort -n | awk '{v[NR] = $1} END {print v[int((NR + 1) / 2)]}'
	done >"$work/$name.median"
}

echo "memo: $count memos in the store; Gnote: $notes note files; $runs runs each" >&2
measure memo memo "--classname com.veltron.memo" -- env ELM_ENGINE=software_x11 ECORE_NO_SYSTEM_MODULES=1 \
	EINA_LOG_BACKTRACE=0 "$build/app/bin/memo"
measure gnote gnote "--classname gnote" -- gnote
{
	cat "$work/memo.median" "$work/gnote.median"
	dpkg-query -W -f='${Version}\n' gnote 2>/dev/null || echo '?'
} | awk -v count="$count" -v notes="$notes" -v runs="$runs" '
	{v[NR] = $1}
	END {
		printf "Cold start to the first visible window, median of %d runs (exec to window; peak memory, VmHWM)\n", runs
		printf "%-30s %8d ms %8.1f MiB\n", "memo (" count " memos)", v[1], v[2] / 1024
		printf "%-30s %8d ms %8.1f MiB\n", "Gnote " v[5] " (" notes " notes)", v[3], v[4] / 1024
		printf "memo / Gnote: time x%.3f (1/%.1f), memory x%.3f (1/%.1f)\n", v[1] / v[3], v[3] / v[1], v[2] / v[4], v[4] / v[2]
	}'
