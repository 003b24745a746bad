// Takes over a new input level only after it has stood still for SETTLE cycles.

module bit_filter #(
    parameter SETTLE = 4
) (
    input  wire clk,
    input  wire rst,
    input  wire raw,
    output reg  clean,
    output reg  changed
);

    localparam AGE_WIDTH = $clog2(SETTLE + 1);
    localparam integer LAST_AGE = SETTLE - 1;

    reg [1:0]           sync;
    reg [AGE_WIDTH-1:0] age;

    always @(posedge clk) begin
        changed <= 1'b0;
        if (rst) begin
            sync  <= 2'b00;
            clean <= 1'b0;
            age   <= {AGE_WIDTH{1'b0}};
        end else begin
            sync <= {sync[0], raw};
            if (sync[1] == clean) begin
                age <= {AGE_WIDTH{1'b0}};
            end else if (age == LAST_AGE[AGE_WIDTH-1:0]) begin
                age     <= {AGE_WIDTH{1'b0}};
                clean   <= sync[1];
                changed <= 1'b1;
            end else begin
                age <= age + 1'b1;
            end
        end
    end

endmodule
