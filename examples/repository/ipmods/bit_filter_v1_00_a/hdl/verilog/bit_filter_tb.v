// A bouncing input must give one change, at the end of the bouncing.

module bit_filter_tb;

    reg  clk = 1'b0;
    reg  rst = 1'b1;
    reg  raw = 1'b0;
    wire clean;
    wire changed;

    integer changes = 0;

    bit_filter #(.SETTLE(3)) dut (
        .clk(clk), .rst(rst), .raw(raw), .clean(clean), .changed(changed)
    );

    initial forever #5 clk = !clk;

    always @(posedge clk)
        if (changed)
            changes <= changes + 1;

    task hold(input level, input integer number);
        begin
            raw = level;
            repeat (number) @(negedge clk);
        end
    endtask

    task expect_state(input level, input integer number);
        if (clean !== level || changes != number)
            $fatal(1, "FAIL: level %b after %0d changes", clean, changes);
    endtask

    initial begin
        hold(1'b0, 4);
        rst = 1'b0;
        hold(1'b1, 2);
        hold(1'b0, 1);
        hold(1'b1, 1);
        hold(1'b0, 8);
        expect_state(1'b0, 0);
        hold(1'b1, 8);
        expect_state(1'b1, 1);
        hold(1'b0, 1);
        hold(1'b1, 1);
        hold(1'b0, 8);
        expect_state(1'b0, 2);
        $display("PASS");
        $finish;
    end

endmodule
