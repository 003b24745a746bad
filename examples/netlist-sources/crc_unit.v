// Checksum over bytes, most significant bit first. While start is high the
// checksum is zero; each byte that meets valid and ready is added to it.
//
// SERIAL = 0 takes a byte in every cycle. SERIAL = 1 is smaller: it is busy for
// eight cycles after each byte, and crc counts only when ready is high again.

module crc_unit #(
    parameter             WIDTH  = 8,
    parameter [WIDTH-1:0] POLY   = 8'h07,
    parameter             SERIAL = 0
) (
    input  wire             clk,
    input  wire             start,
    input  wire             valid,
    input  wire [7:0]       data,
    output wire             ready,
    output reg  [WIDTH-1:0] crc
);

    function [WIDTH-1:0] add_bit(input [WIDTH-1:0] value, input next);
        add_bit = {value[WIDTH-2:0], 1'b0} ^ ({WIDTH{value[WIDTH-1] ^ next}} & POLY);
    endfunction

    generate
        if (SERIAL != 0) begin : serial
            reg [7:0] rest;
            reg [3:0] left;

            assign ready = left == 4'd0;

            always @(posedge clk) begin
                if (start) begin
                    crc  <= {WIDTH{1'b0}};
                    left <= 4'd0;
                end else if (valid && ready) begin
                    rest <= data;
                    left <= 4'd8;
                end else if (!ready) begin
                    crc  <= add_bit(crc, rest[7]);
                    rest <= {rest[6:0], 1'b0};
                    left <= left - 4'd1;
                end
            end
        end else begin : parallel
            reg [WIDTH-1:0] sum;
            integer         i;

            assign ready = 1'b1;

            always @* begin
                sum = crc;
                for (i = 7; i >= 0; i = i - 1)
                    sum = add_bit(sum, data[i]);
            end

            always @(posedge clk) begin
                if (start)
                    crc <= {WIDTH{1'b0}};
                else if (valid)
                    crc <= sum;
            end
        end
    endgenerate

endmodule
