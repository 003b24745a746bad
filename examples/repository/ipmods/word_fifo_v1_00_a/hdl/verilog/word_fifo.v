// First-in first-out store for words, with a ready and valid pair at each end.

`include "word_fifo_defs.vh"

module word_fifo #(
    parameter WIDTH      = 8,
    parameter DEPTH_LOG2 = 4
) (
    input  wire             clk,
    input  wire             rst,
    input  wire [WIDTH-1:0] in_data,
    input  wire             in_valid,
    output wire             in_ready,
    output wire [WIDTH-1:0] out_data,
    output wire             out_valid,
    input  wire             out_ready,
    output wire [`WORD_FIFO_STATUS_WIDTH-1:0] status
);

    reg [WIDTH-1:0]    words [0:(1 << DEPTH_LOG2)-1];
    reg [DEPTH_LOG2:0] head;
    reg [DEPTH_LOG2:0] tail;

    // the pointers have one bit more than an address, so that full and empty differ
    wire [DEPTH_LOG2:0] used = head - tail;

    assign in_ready  = !used[DEPTH_LOG2];
    assign out_valid = used != {(DEPTH_LOG2 + 1){1'b0}};
    assign out_data  = words[tail[DEPTH_LOG2-1:0]];

    assign status[`WORD_FIFO_EMPTY]     = !out_valid;
    assign status[`WORD_FIFO_HALF_FULL] = used[DEPTH_LOG2] | used[DEPTH_LOG2-1];

    always @(posedge clk) begin
        if (in_valid && in_ready)
            words[head[DEPTH_LOG2-1:0]] <= in_data;
        if (rst) begin
            head <= {(DEPTH_LOG2 + 1){1'b0}};
            tail <= {(DEPTH_LOG2 + 1){1'b0}};
        end else begin
            if (in_valid && in_ready)
                head <= head + 1'b1;
            if (out_valid && out_ready)
                tail <= tail + 1'b1;
        end
    end

endmodule
