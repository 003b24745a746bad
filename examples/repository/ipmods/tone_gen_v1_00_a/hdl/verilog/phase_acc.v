// Phase accumulator: adds the step in each enabled cycle.

module phase_acc #(
    parameter WIDTH = 16
) (
    input  wire             clk,
    input  wire             rst,
    input  wire             enable,
    input  wire [WIDTH-1:0] step,
    output reg  [WIDTH-1:0] phase,
    output reg              wrap
);

    always @(posedge clk) begin
        if (rst) begin
            phase <= {WIDTH{1'b0}};
            wrap  <= 1'b0;
        end else if (enable) begin
            {wrap, phase} <= {1'b0, phase} + {1'b0, step};
        end else begin
            wrap <= 1'b0;
        end
    end

endmodule
