// Cuts a stream of bytes into frames: a mark, FRAME_LENGTH bytes that may be
// scrambled, and the checksum of those bytes before scrambling.

`include "link_framer_defs.vh"
`include "word_fifo_defs.vh"

module link_framer #(
    parameter FRAME_LENGTH = 4,
    parameter SCRAMBLE     = 1
) (
    input  wire       clk,
    input  wire       rst,
    input  wire [7:0] in_data,
    input  wire       in_valid,
    output wire       in_ready,
    output reg  [7:0] out_data,
    output reg        out_valid,
    input  wire       out_ready,
    output wire       out_last,
    output wire       busy,
    output wire       half_full
);

    localparam [1:0] MARK    = 2'd0;
    localparam [1:0] PAYLOAD = 2'd1;
    localparam [1:0] CHECK   = 2'd2;

    localparam LEFT_WIDTH = $clog2(FRAME_LENGTH + 1);
    localparam integer FIRST_LEFT = FRAME_LENGTH - 1;

    reg  [1:0]            state;
    reg  [LEFT_WIDTH-1:0] left;
    wire [7:0]            plain;
    wire [7:0]            payload;
    wire                  plain_valid;
    wire [7:0]            crc;
    wire                  crc_ready;
    wire [`WORD_FIFO_STATUS_WIDTH-1:0] status;

    wire sent  = out_valid && out_ready;
    wire taken = sent && state == PAYLOAD;
    wire start = rst || state == MARK;

    assign out_last  = state == CHECK;
    assign busy      = !status[`WORD_FIFO_EMPTY] || state != MARK;
    assign half_full = status[`WORD_FIFO_HALF_FULL];

    word_fifo #(.WIDTH(8), .DEPTH_LOG2(3)) fifo (
        .clk(clk), .rst(rst),
        .in_data(in_data), .in_valid(in_valid), .in_ready(in_ready),
        .out_data(plain), .out_valid(plain_valid), .out_ready(taken),
        .status(status)
    );

    crc_unit checksum (
        .clk(clk), .start(start), .valid(taken), .data(plain),
        .ready(crc_ready), .crc(crc)
    );

    generate
        if (SCRAMBLE != 0) begin : scrambled
            scrambler keys (
                .clk(clk), .start(start), .step(taken),
                .data_in(plain), .data_out(payload)
            );
        end else begin : unscrambled
            assign payload = plain;
        end
    endgenerate

    always @* begin
        case (state)
            MARK:    {out_valid, out_data} = {plain_valid, `LINK_FRAMER_MARK};
            PAYLOAD: {out_valid, out_data} = {plain_valid && crc_ready, payload};
            default: {out_valid, out_data} = {crc_ready, crc};
        endcase
    end

    always @(posedge clk) begin
        if (rst) begin
            state <= MARK;
            left  <= {LEFT_WIDTH{1'b0}};
        end else if (sent) begin
            case (state)
                MARK: begin
                    state <= PAYLOAD;
                    left  <= FIRST_LEFT[LEFT_WIDTH-1:0];
                end
                PAYLOAD: begin
                    if (left == {LEFT_WIDTH{1'b0}})
                        state <= CHECK;
                    left <= left - 1'b1;
                end
                default: state <= MARK;
            endcase
        end
    end

endmodule
