// Tries all sets of lanes that have a word.

`include "lanes/lane_word.svh"

module lane_merge_tb;

    logic [3*`LANE_WORD_BITS-1:0] next;
    logic [3*`LANE_WORD_BITS-1:0] words;
    lane_word_t                   merged;
    logic [3:0]                   lane;
    int                           first;

    lane_merge #(.LANES(3)) dut (.words(words), .merged(merged), .lane(lane));

    initial begin
        for (int set = 0; set < 8; set++) begin
            first = 0;
            for (int i = 2; i >= 0; i--) begin
                next[i*`LANE_WORD_BITS +: `LANE_WORD_BITS] = {set[i], 8'(16 * i + 1)};
                if (set[i]) first = i;
            end
            words = next;
            #1;
            if (merged.valid != (set != 0) || lane != 4'(first)
                || (set != 0 && merged.data != 8'(16 * first + 1)))
                $fatal(1, "FAIL: set %0d gives lane %0d and %h", set, lane, merged);
        end
        $display("PASS");
        $finish;
    end

endmodule
