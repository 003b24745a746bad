#!/bin/bash
# Makes the EDIF netlists of the example repository again, from Verilog and with
# Yosys. The same sources and the same Yosys always give the same files.
set -euo pipefail

examples=$(cd "$(dirname "${BASH_SOURCE[0]}")/../examples" && pwd)
ipmods=$examples/repository/ipmods
sources=$examples/netlist-sources
scratch=$(mktemp -d)
trap 'rm -rf "$scratch"' EXIT

# netlist <result> <source> <module> [<parameter> <value>]...
netlist() {
    local result=$1 source=$2 module=$3
    shift 3
    local settings=()
    while (($#)); do
        settings+=(-set "$1" "$2")
        shift 2
    done
    local chparam=
    if ((${#settings[@]})); then
        chparam="chparam ${settings[*]} $module"
    fi

    cp "$source" "$scratch/source.v"
    cp "$sources/cells.lib" "$scratch/cells.lib"
    cat >"$scratch/run.ys" <<END
read_liberty -lib cells.lib
read_verilog source.v
$chparam
synth -flatten -top $module
dfflibmap -liberty cells.lib
abc -liberty cells.lib -script +strash;dch;map
hilomap -hicell ONE Y -locell ZERO Y
opt_clean -purge
rename -enumerate -pattern u% c:*
rename -enumerate -pattern n% w:*
write_edif -nogndvcc -pvector bra result.edif
END
    (cd "$scratch" && yosys -q run.ys)
    # the name of the tool and half of the indentation are of no use to a reader
    sed -E -e '/^ *\(comment /d' -e 's/^( *)\1/\1/' "$scratch/result.edif" >"$result"
    echo "${result#"$examples"/}: $(wc -c <"$result") bytes"
}

unit=$ipmods/crc_unit_v1_00_a/netlist
mkdir -p "$unit"
for mode in fast:0 small:1; do
    name=${mode%:*} serial=${mode#*:}
    netlist "$unit/crc_unit_w8_$name.edif" "$sources/crc_unit.v" crc_unit \
        WIDTH 8 POLY "8'h07" SERIAL "$serial"
    netlist "$unit/crc_unit_w16_$name.edif" "$sources/crc_unit.v" crc_unit \
        WIDTH 16 POLY "16'h1021" SERIAL "$serial"
done

framer=$ipmods/link_framer_v1_00_a
mkdir -p "$framer/netlist"
netlist "$framer/netlist/scrambler.edif" "$framer/hdl/verilog/models/scrambler.v" scrambler
