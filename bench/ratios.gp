# SPDX-License-Identifier: MIT
# Bars of the ratios. $data has lines of workload, ratio, goal and fastest peer.
set terminal svg size 820,420 font "sans-serif,12" background "white"
set style fill solid
set boxwidth 0.7
set ylabel "CPU time of the fastest peer / that of umpre"
set yrange [0:*]
set offsets 0.6, 0.6, 1, 0
set grid ytics
set xtics rotate by -35 nomirror
set key top right
plot $data using 0:2:xtic(1) with boxes linecolor "#4477aa" title "measured", \
    $data using ($0 - 0.4):3:(0.8):(0) with vectors nohead linewidth 2 linecolor "#cc6677" \
        title "goal", \
    $data using 0:2:4 with labels offset 0,0.6 font ",10" notitle
