-- Two loads of a recording, of which the later one counts, and one that was broken off.
INSERT INTO loads_local (load, gone, device, name, digest) VALUES
    (7, 0, 'car1', 'a.pcap', 'abc'), (9, 0, 'car1', 'a.pcap', 'abc'), (5, 0, 'car2', 'b.pcap', 'def'),
    (6, 1, 'car2', 'b.pcap', 'def');
INSERT INTO intervals_local (device, load, month, field, entry, system, cell, day, minute, second, ms,
    hold_minutes, hold_seconds, hold_ms, part, whole_minutes, whole_seconds, whole_ms, known, steps, step, rest, decimals, suffix, text, raw, reason, unit, packet_high,
    packet_middle, packet_low, recording, technology, decoder) VALUES
    ('car1', 7, 202201, 'f', '', 'lte', 'PCI 1', 19000, 5, 0, 100, 0, 0, 500, 0, 0, 0, 0, 1, 1, 1, 0, 0, '', '', NULL, '',
        'dBm', 0, 0, 1, 'a.pcap', 'lte', '0.1'),
    ('car1', 9, 202201, 'f', '', 'lte', 'PCI 1', 19000, 5, 0, 100, 2, 0, 500, 0, 0, 0, 0, 1, -1324, 0.0625, 0, 2, ' dBm', '',
        NULL, '', 'dBm', 1, 0, 3, 'a.pcap', 'lte', '0.2'),
    ('car1', 9, 202201, 'g', 'x', '', '', 19000, 5, 0, 100, 0, 0, 500, 1, 0, 0, 900, 0, 0, 0, 0, -1, '', 'Idle [2]', 2,
        'out of range', '', 0, 0, 3, 'a.pcap', 'lte', '0.2'),
    ('car1', 9, 202201, 'g', 'x', '', '', 19000, 5, 0, 600, 0, 0, 400, 2, 0, 0, 0, 0, 0, 0, 0, -1, '', 'Idle [2]', 2,
        'out of range', '', 0, 0, 3, 'a.pcap', 'lte', '0.2'),
    ('car2', 5, 202201, 'f', '', '', '', 19000, 5, 0, 100, 0, 0, 500, 0, 0, 0, 0, 1, 1, 1, 0, 0, '', '', NULL, '', 'dBm', 0, 0,
        1, 'b.pcap', 'lte', '0.1'),
    ('car3', 8, 202201, 'f', '', '', '', 19000, 5, 0, 100, 0, 0, 500, 0, 0, 0, 0, 1, 1, 1, 0, 0, '', '', NULL, '', 'dBm', 0, 0,
        1, 'c.pcap', 'lte', '0.1');
SELECT * FROM span ORDER BY field;
SELECT * FROM measurement ORDER BY field, start;
SELECT * FROM level_by_minute ORDER BY start;
SELECT * FROM level_by_hour;
SELECT device, name FROM recordings;
INSERT INTO fields_local (name, unit, load, content) VALUES ('f', 'dB', 1, 'a'), ('f', 'dBm', 2, 'b');
SELECT name, unit FROM field;
SELECT count() FROM event;
SELECT count() FROM cell;
SELECT quantileExactWeighted(0.5)(number, toUInt64(hold)) FROM measurement WHERE number < 0;
SELECT version, cluster, copies FROM store
