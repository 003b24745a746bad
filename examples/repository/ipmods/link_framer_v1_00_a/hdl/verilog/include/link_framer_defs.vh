// The byte that begins each frame of link_framer.

`ifndef LINK_FRAMER_DEFS_VH
`define LINK_FRAMER_DEFS_VH

`define LINK_FRAMER_MARK 8'hA5

`endif
