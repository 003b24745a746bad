// Adds a repeating key of 127 bits to the bytes. The netlist of the same name is
// made from this file.

module scrambler (
    input  wire       clk,
    input  wire       start,
    input  wire       step,
    input  wire [7:0] data_in,
    output reg  [7:0] data_out
);

    reg [6:0] key;
    reg [6:0] next;
    integer   i;

    always @* begin
        next = key;
        for (i = 7; i >= 0; i = i - 1) begin
            data_out[i] = data_in[i] ^ next[6];
            next = {next[5:0], next[6] ^ next[5]};
        end
    end

    always @(posedge clk) begin
        if (start)
            key <= 7'h7F;
        else if (step)
            key <= next;
    end

endmodule
