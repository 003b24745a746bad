// Stands in for the netlist crc_unit with WIDTH = 8 and MODE = SMALL: the sum
// is made at once, and the eight busy cycles are only waited for.

module crc_unit (
    input  wire       clk,
    input  wire       start,
    input  wire       valid,
    input  wire [7:0] data,
    output wire       ready,
    output reg  [7:0] crc
);

    reg [3:0] left;

    function [7:0] add_byte(input [7:0] value);
        integer i;
        begin
            add_byte = value;
            for (i = 0; i < 8; i = i + 1)
                add_byte = {add_byte[6:0], 1'b0} ^ (add_byte[7] ? 8'h07 : 8'h00);
        end
    endfunction

    assign ready = left == 4'd0;

    always @(posedge clk) begin
        if (start) begin
            crc  <= 8'h00;
            left <= 4'd0;
        end else if (valid && ready) begin
            crc  <= add_byte(crc ^ data);
            left <= 4'd8;
        end else if (!ready) begin
            left <= left - 4'd1;
        end
    end

endmodule
