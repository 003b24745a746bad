// Bits of the status port of word_fifo.

`ifndef WORD_FIFO_DEFS_VH
`define WORD_FIFO_DEFS_VH

`define WORD_FIFO_STATUS_WIDTH 2
`define WORD_FIFO_EMPTY        0
`define WORD_FIFO_HALF_FULL    1

`endif
