// Sends 24 bytes through two framers, one of which scrambles. Takes the frames
// apart again and checks the marks, the payload and the checksums.

`include "link_framer_defs.vh"

module link_framer_tb;

    localparam LENGTH = 3;

    reg        clk = 1'b0;
    reg        rst = 1'b1;
    reg  [7:0] in_data = 8'd0;
    wire [1:0] in_ready;
    wire [7:0] out_data [0:1];
    wire [1:0] out_valid;
    reg        out_ready = 1'b0;
    wire [1:0] out_last;
    wire [1:0] busy;
    wire [1:0] half_full;
    reg        half_seen = 1'b0;

    // both framers take and give their bytes in the same cycles
    wire in_valid = !rst && in_data < 8'd24;
    wire sent     = out_ready && &out_valid;

    genvar g;
    generate
        for (g = 0; g < 2; g = g + 1) begin : framers
            link_framer #(.FRAME_LENGTH(LENGTH), .SCRAMBLE(g)) dut (
                .clk(clk), .rst(rst), .in_data(8'd37 * in_data), .in_valid(in_valid),
                .in_ready(in_ready[g]), .out_data(out_data[g]), .out_valid(out_valid[g]),
                .out_ready(out_ready), .out_last(out_last[g]), .busy(busy[g]),
                .half_full(half_full[g])
            );
        end
    endgenerate

    reg [7:0] expected = 8'd0;
    reg [7:0] sum = 8'd0;
    integer   place = 0;
    integer   frames = 0;
    integer   different = 0;

    function [7:0] add_byte(input [7:0] crc, input [7:0] value);
        integer i;
        begin
            add_byte = crc ^ value;
            for (i = 0; i < 8; i = i + 1)
                add_byte = {add_byte[6:0], 1'b0} ^ (add_byte[7] ? 8'h07 : 8'h00);
        end
    endfunction

    task check(input okay);
        if (!okay)
            $fatal(1, "FAIL: byte %0d of frame %0d is %h", place, frames, out_data[0]);
    endtask

    initial forever #5 clk = !clk;

    always @(posedge clk) begin
        half_seen <= half_seen || &half_full;
        check(in_ready[0] === in_ready[1] && out_valid[0] === out_valid[1] || rst);
        if (in_valid && &in_ready)
            in_data <= in_data + 8'd1;
        if (sent) begin
            check(&out_last === (place == LENGTH + 1));
            if (place == 0) begin
                check(out_data[0] === `LINK_FRAMER_MARK && out_data[1] === `LINK_FRAMER_MARK);
                sum <= 8'd0;
            end else if (place <= LENGTH) begin
                check(out_data[0] === expected);
                sum       <= add_byte(sum, out_data[0]);
                expected  <= expected + 8'd37;
                different <= different + (out_data[0] !== out_data[1] ? 1 : 0);
            end else begin
                check(out_data[0] === sum && out_data[1] === sum);
                frames <= frames + 1;
            end
            place <= place == LENGTH + 1 ? 0 : place + 1;
        end
    end

    integer cycle;

    initial begin
        repeat (2) @(negedge clk);
        rst = 1'b0;
        for (cycle = 0; cycle < 400; cycle = cycle + 1) begin
            out_ready = cycle % 4 != 0;
            @(negedge clk);
        end
        if (frames != 8 || different < 20 || |busy || !half_seen)
            $fatal(1, "FAIL: %0d frames, %0d scrambled bytes", frames, different);
        $display("PASS");
        $finish;
    end

endmodule
