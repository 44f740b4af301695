-- LTE log records for tshark: the header, the serving cell measurement and both neighbour lists.
-- What a user would otherwise decode recordings with; bench/run times it.

local lte = Proto("pallax_lte", "LTE log record")
local f = {
    type = ProtoField.uint8("pallax_lte.type", "Log type", base.HEX),
    code = ProtoField.uint16("pallax_lte.code", "Log code", base.HEX),
    length = ProtoField.uint32("pallax_lte.length", "Length"),
    earfcn = ProtoField.uint16("pallax_lte.earfcn", "E-ARFCN"),
    pci = ProtoField.uint16("pallax_lte.pci", "Physical cell ID"),
    rsrp = ProtoField.double("pallax_lte.rsrp", "Measured RSRP, dBm"),
    rsrq = ProtoField.double("pallax_lte.rsrq", "Measured RSRQ, dB"),
    rssi = ProtoField.double("pallax_lte.rssi", "Measured RSSI, dBm"),
    neighbour = ProtoField.uint16("pallax_lte.neighbour", "Neighbour's physical cell ID"),
    neighbour_rsrp = ProtoField.double("pallax_lte.neighbour_rsrp", "Neighbour's RSRP, dBm"),
    measured = ProtoField.uint16("pallax_lte.measured", "Measured neighbour's physical cell ID"),
    measured_rsrp = ProtoField.double("pallax_lte.measured_rsrp", "Filtered RSRP, dBm"),
}
lte.fields = f

local SERVING, NEIGHBOURS, CONNECTED = 0xB17F, 0xB180, 0xB179

-- The bits [bit, bit + width) of the little-endian number at `at`.
local function bits(record, at, bit, width)
    local value = record(at, math.min(4, record:len() - at)):le_uint()
    return math.floor(value / 2 ^ bit) % 2 ^ width
end

local function serving_cell(record, tree)
    if record:len() < 33 then return end
    tree:add_le(f.earfcn, record(17, 2))
    tree:add(f.pci, record(19, 2), bits(record, 19, 0, 9))
    tree:add(f.rsrp, record(21, 2), bits(record, 21, 0, 9) * 0.25 - 140)
    tree:add(f.rsrq, record(23, 2), bits(record, 23, 2, 7) * 0.25 - 30)
    tree:add(f.rssi, record(25, 2), bits(record, 25, 0, 9) * 0.5 - 140)
end

local function neighbours(record, tree)
    local start = 21
    if record:len() < start then return end
    for index = 0, bits(record, 19, 6, 5) do
        local at = start + 20 * index
        if record:len() < at + 16 then return end
        tree:add(f.neighbour, record(at, 2), bits(record, at, 0, 9))
        tree:add(f.neighbour_rsrp, record(at + 2, 2), bits(record, at + 2, 1, 9) * 0.5 - 140)
    end
end

local function measured(record, tree)
    local start, count_at = 29, 27
    if record:len() < start then return end
    for index = 0, record(count_at, 1):uint() - 1 do
        local at = start + 6 * index
        if record:len() < at + 6 then return end
        tree:add_le(f.measured, record(at, 2))
        tree:add(f.measured_rsrp, record(at + 2, 2), record(at + 2, 2):le_uint() * 0.25 - 140)
    end
end

function lte.dissector(buffer, pinfo, root)
    local start = buffer:len() > 2 and buffer(0, 1):uint() == 0x81 and 2 or 0
    local record = buffer(start):tvb()
    if record:len() < 13 then return end
    pinfo.cols.protocol = "PALLAX LTE"
    local tree = root:add(lte, record())
    local code = record(3, 2):le_uint()
    tree:add(f.type, record(0, 1))
    tree:add_le(f.code, record(3, 2))
    tree:add(f.length, record:len())
    if code == SERVING then
        serving_cell(record, tree)
    elseif code == NEIGHBOURS then
        neighbours(record, tree)
    elseif code == CONNECTED then
        measured(record, tree)
    end
end

DissectorTable.get("wtap_encap"):add(wtap.USER3, lte)
