`include "lanes/lane_word.svh"

module lane_merge #(
    parameter int LANES = 3
) (
    input  logic [LANES*`LANE_WORD_BITS-1:0] words,
    output lane_word_t                       merged,
    output logic [3:0]                       lane
);

    lane_word_t candidate;

    always_comb begin
        merged = '0;
        lane   = '0;
        for (int i = LANES - 1; i >= 0; i--) begin
            candidate = words[i*`LANE_WORD_BITS +: `LANE_WORD_BITS];
            if (candidate.valid) begin
                merged = candidate;
                lane   = 4'(i);
            end
        end
    end

endmodule
