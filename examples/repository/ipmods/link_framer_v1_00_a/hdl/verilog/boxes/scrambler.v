// Ports of the netlist scrambler.

// verilator lint_off UNUSED
// verilator lint_off UNDRIVEN
(* blackbox *)
module scrambler (
    input  wire       clk,
    input  wire       start,
    input  wire       step,
    input  wire [7:0] data_in,
    output wire [7:0] data_out
);
endmodule
