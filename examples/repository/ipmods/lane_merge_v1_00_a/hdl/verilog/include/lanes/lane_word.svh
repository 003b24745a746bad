// A word with its valid bit, for all that deal with lanes.
`ifndef LANE_WORD_SVH
`define LANE_WORD_SVH

`define LANE_WORD_BITS 9

typedef struct packed {
  logic       valid;
  logic [7:0] data;
} lane_word_t;

`endif
