// Fills the store, then reads and writes at uneven rates and checks the order.

`include "word_fifo_defs.vh"

module word_fifo_tb;

    reg        clk = 1'b0;
    reg        rst = 1'b1;
    reg  [7:0] in_data = 8'd0;
    reg        in_valid = 1'b0;
    wire       in_ready;
    wire [7:0] out_data;
    wire       out_valid;
    reg        out_ready = 1'b0;
    wire [`WORD_FIFO_STATUS_WIDTH-1:0] status;

    reg  [7:0] expected = 8'd0;
    integer    cycle;

    word_fifo #(.WIDTH(8), .DEPTH_LOG2(2)) dut (
        .clk(clk), .rst(rst),
        .in_data(in_data), .in_valid(in_valid), .in_ready(in_ready),
        .out_data(out_data), .out_valid(out_valid), .out_ready(out_ready),
        .status(status)
    );

    initial forever #5 clk = !clk;

    always @(posedge clk) begin
        if (in_valid && in_ready)
            in_data <= in_data + 8'd1;
        if (out_valid && out_ready) begin
            if (out_data !== expected)
                $fatal(1, "FAIL: word %0d where %0d was expected", out_data, expected);
            expected <= expected + 8'd1;
        end
    end

    initial begin
        repeat (2) @(negedge clk);
        rst = 1'b0;
        if (!status[`WORD_FIFO_EMPTY] || out_valid)
            $fatal(1, "FAIL: not empty after reset");
        in_valid = 1'b1;
        repeat (6) @(negedge clk);
        if (in_ready || !status[`WORD_FIFO_HALF_FULL] || in_data != 8'd4)
            $fatal(1, "FAIL: not full after four words");
        for (cycle = 0; cycle < 200; cycle = cycle + 1) begin
            in_valid  = cycle % 3 != 0;
            out_ready = cycle % 5 < 3;
            @(negedge clk);
        end
        in_valid  = 1'b0;
        out_ready = 1'b1;
        repeat (6) @(negedge clk);
        if (!status[`WORD_FIFO_EMPTY] || expected != in_data || expected < 8'd100)
            $fatal(1, "FAIL: %0d words in, %0d words out", in_data, expected);
        $display("PASS");
        $finish;
    end

endmodule
