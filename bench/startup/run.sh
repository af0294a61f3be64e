#!/usr/bin/env bash
# Start-up, About scrolling and memory of the launcher against a bare toolkit frame of the
# splash's size with a menu bar, measured in the same run. Usage: run.sh BUILD_DIR
set -euo pipefail
dir="$1/bench/startup"
runs=5
field() { awk -v k="$1" '$1 == k { print $2 }' <<<"$2"; }

bare_ms=() splash_ms=() frame_gap_ms=() bare_rss=() about_rss=() tick_cpu=() bare_cpu=() splash_cpu=()
for _ in $(seq $runs); do
    start=$(date +%s%N); out=$("$dir/bench_bare_frame" 2>/dev/null)
    bare_ms+=($(( ($(field first_paint "$out") - start) / 1000000 )))
    bare_cpu+=($(( $(field first_paint_cpu_us "$out") / 1000 )))
    bare_rss+=($(field peak_rss_kb "$out"))
done
# A private runtime directory, so no other copy of the launcher is seen.
export XDG_RUNTIME_DIR=$(mktemp -d); chmod 700 "$XDG_RUNTIME_DIR"
trap 'rm -rf "$XDG_RUNTIME_DIR"' EXIT
for _ in $(seq $runs); do
    start=$(date +%s%N); out=$("$dir/bench_startup_probe" 2>/dev/null)
    paint=$(field splash_first_paint "$out")
    splash_ms+=($(( (paint - start) / 1000000 )))
    splash_cpu+=($(( $(field splash_first_paint_cpu_us "$out") / 1000 )))
    frame_gap_ms+=($(( ($(field frame_shown "$out") - paint) / 1000000 )))
    about_rss+=($(field peak_rss_kb "$out"))
    tick_cpu+=($(field about_cpu_ms_per_tick "$out"))
    about="$out"
done
median() { printf '%s\n' "$@" | sort -n | sed -n "$(( ($# + 1) / 2 ))p"; }
echo "exec to first paint (median of $runs): splash $(median "${splash_ms[@]}") ms, bare frame $(median "${bare_ms[@]}") ms (goal: at most 1.1 x)"
echo "main thread's CPU to first paint (median): splash $(median "${splash_cpu[@]}") ms, bare frame $(median "${bare_cpu[@]}") ms"
echo "splash first paint to frame shown (median): $(median "${frame_gap_ms[@]}") ms (goal: at most 2050 ms)"
echo "About scrolling (median): $(median "${tick_cpu[@]}") ms CPU per tick over $(field about_ticks "$about") ticks (goal: at most 1 ms); largest repaint $(field about_largest_paint_px "$about") px, whole About picture $((443 * 454)) px"
echo "peak RSS (median): launcher with About open $(median "${about_rss[@]}") kB, bare frame $(median "${bare_rss[@]}") kB (goal: at most 1.4 x)"
