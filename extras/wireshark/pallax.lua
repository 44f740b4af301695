-- Shows the log records of radio modems as Pallax decodes them.
--
-- Written by make_reference out of the tables that the records are decoded with, and of
-- reference/dissector. To use it:
--
--     wireshark -X lua_script:pallax.lua RECORDING
--     tshark -X lua_script:pallax.lua -V -r RECORDING
--
-- or put it among the analyser's personal plugins.

local technologies = {
  {
    name = "pallax_ifx", title = "IFX", encapsulation = "USER0",
    framing = "object",
    codes = {
    },
    objects = {
      ["Network"] = { filter = "network", keys = { ["Name"] = "network.name", ["MCC"] = "network.mcc", ["MNC"] = "network.mnc" } },
      ["RR"] = { filter = "rr", keys = {  } },
      ["Serving Cell"] = { filter = "serving_cell", keys = { ["ARFCN"] = "serving_cell.arfcn", ["BSIC"] = "serving_cell.bsic", ["Rx Level"] = "serving_cell.rx_level", ["C1"] = "serving_cell.c1", ["Area"] = "serving_cell.area", ["LAC"] = "serving_cell.lac", ["Cell ID"] = "serving_cell.cell_id", ["Source"] = "serving_cell.source", ["Cell Information"] = "serving_cell.cell_information", ["Timing Advance"] = "serving_cell.timing_advance", ["Technology"] = "serving_cell.technology", ["Operator Code"] = "serving_cell.operator_code", ["TAC"] = "serving_cell.tac", ["UARFCN"] = "serving_cell.uarfcn", ["EARFCN"] = "serving_cell.earfcn", ["NR-ARFCN"] = "serving_cell.nr_arfcn", ["Scrambling Code"] = "serving_cell.scrambling_code", ["Cell Parameter ID"] = "serving_cell.cell_parameter_id", ["Physical Cell ID"] = "serving_cell.physical_cell_id", ["Base Station ID"] = "serving_cell.base_station_id", ["SID"] = "serving_cell.sid", ["NID"] = "serving_cell.nid", ["PN"] = "serving_cell.pn", ["RSRP"] = "serving_cell.rsrp", ["RSRQ"] = "serving_cell.rsrq", ["SINR"] = "serving_cell.sinr", ["RSCP"] = "serving_cell.rscp", ["Ec/Io"] = "serving_cell.ec_io", ["RSSI"] = "serving_cell.rssi", ["Path Loss"] = "serving_cell.path_loss", ["Bandwidth"] = "serving_cell.bandwidth" } },
      ["Neighbour Cells"] = { filter = "neighbour_cells", keys = { ["ARFCN"] = "neighbour_cells.arfcn", ["BSIC"] = "neighbour_cells.bsic", ["Rx Level"] = "neighbour_cells.rx_level", ["LAC"] = "neighbour_cells.lac", ["Cell ID"] = "neighbour_cells.cell_id", ["Timing Advance"] = "neighbour_cells.timing_advance", ["Technology"] = "neighbour_cells.technology", ["Operator Code"] = "neighbour_cells.operator_code", ["TAC"] = "neighbour_cells.tac", ["UARFCN"] = "neighbour_cells.uarfcn", ["EARFCN"] = "neighbour_cells.earfcn", ["NR-ARFCN"] = "neighbour_cells.nr_arfcn", ["Scrambling Code"] = "neighbour_cells.scrambling_code", ["Cell Parameter ID"] = "neighbour_cells.cell_parameter_id", ["Physical Cell ID"] = "neighbour_cells.physical_cell_id", ["Base Station ID"] = "neighbour_cells.base_station_id", ["SID"] = "neighbour_cells.sid", ["NID"] = "neighbour_cells.nid", ["PN"] = "neighbour_cells.pn", ["RSRP"] = "neighbour_cells.rsrp", ["RSRQ"] = "neighbour_cells.rsrq", ["SINR"] = "neighbour_cells.sinr", ["RSCP"] = "neighbour_cells.rscp", ["Ec/Io"] = "neighbour_cells.ec_io", ["RSSI"] = "neighbour_cells.rssi", ["Path Loss"] = "neighbour_cells.path_loss", ["Bandwidth"] = "neighbour_cells.bandwidth" } },
      ["Dedicated Channel"] = { filter = "dedicated_channel", keys = { ["Channel"] = "dedicated_channel.channel", ["Time Slot"] = "dedicated_channel.time_slot", ["Timing Advance"] = "dedicated_channel.timing_advance", ["Rx Quality"] = "dedicated_channel.rx_quality", ["Tx Power"] = "dedicated_channel.tx_power", ["Hopping"] = "dedicated_channel.hopping" } },
      ["Barred Cells"] = { filter = "barred_cells", keys = {  } },
      ["Registration"] = { filter = "registration", keys = { ["State"] = "registration.state", ["Technology"] = "registration.technology", ["Operator"] = "registration.operator", ["Operator Code"] = "registration.operator_code", ["LAC"] = "registration.lac", ["TAC"] = "registration.tac", ["Cell ID"] = "registration.cell_id", ["1x"] = "registration.1x", ["EV-DO"] = "registration.ev_do", ["SID"] = "registration.sid", ["NID"] = "registration.nid", ["Packet Service"] = "registration.packet_service", ["Rejection"] = "registration.rejection" } },
      ["Signal"] = { filter = "signal", keys = { ["Quality"] = "signal.quality", ["Recent"] = "signal.recent", ["Levels"] = "signal.levels", ["GSM RSSI"] = "signal.gsm_rssi", ["UMTS RSSI"] = "signal.umts_rssi", ["UMTS RSCP"] = "signal.umts_rscp", ["UMTS Ec/Io"] = "signal.umts_ec_io", ["LTE RSSI"] = "signal.lte_rssi", ["LTE RSRP"] = "signal.lte_rsrp", ["LTE RSRQ"] = "signal.lte_rsrq", ["LTE SINR"] = "signal.lte_sinr", ["NR RSRP"] = "signal.nr_rsrp", ["NR RSRQ"] = "signal.nr_rsrq", ["NR SINR"] = "signal.nr_sinr", ["1x RSSI"] = "signal.1x_rssi", ["1x Ec/Io"] = "signal.1x_ec_io", ["EV-DO RSSI"] = "signal.ev_do_rssi", ["EV-DO Ec/Io"] = "signal.ev_do_ec_io", ["EV-DO SINR"] = "signal.ev_do_sinr", ["EV-DO Io"] = "signal.ev_do_io" } },
      ["Further Serving Cells"] = { filter = "further_serving_cells", keys = { ["ARFCN"] = "further_serving_cells.arfcn", ["BSIC"] = "further_serving_cells.bsic", ["LAC"] = "further_serving_cells.lac", ["Cell ID"] = "further_serving_cells.cell_id", ["Rx Level"] = "further_serving_cells.rx_level", ["Timing Advance"] = "further_serving_cells.timing_advance", ["Technology"] = "further_serving_cells.technology", ["Operator Code"] = "further_serving_cells.operator_code", ["TAC"] = "further_serving_cells.tac", ["UARFCN"] = "further_serving_cells.uarfcn", ["EARFCN"] = "further_serving_cells.earfcn", ["NR-ARFCN"] = "further_serving_cells.nr_arfcn", ["Scrambling Code"] = "further_serving_cells.scrambling_code", ["Cell Parameter ID"] = "further_serving_cells.cell_parameter_id", ["Physical Cell ID"] = "further_serving_cells.physical_cell_id", ["Base Station ID"] = "further_serving_cells.base_station_id", ["SID"] = "further_serving_cells.sid", ["NID"] = "further_serving_cells.nid", ["PN"] = "further_serving_cells.pn", ["RSRP"] = "further_serving_cells.rsrp", ["RSRQ"] = "further_serving_cells.rsrq", ["SINR"] = "further_serving_cells.sinr", ["RSCP"] = "further_serving_cells.rscp", ["Ec/Io"] = "further_serving_cells.ec_io", ["RSSI"] = "further_serving_cells.rssi", ["Path Loss"] = "further_serving_cells.path_loss", ["Bandwidth"] = "further_serving_cells.bandwidth" } },
      ["Data Connections"] = { filter = "data_connections", keys = { ["State"] = "data_connections.state", ["Type"] = "data_connections.type", ["Interface"] = "data_connections.interface", ["APN"] = "data_connections.apn", ["IP Type"] = "data_connections.ip_type", ["Duration"] = "data_connections.duration", ["Received"] = "data_connections.received", ["Sent"] = "data_connections.sent" } },
      ["SIM"] = { filter = "sim", keys = { ["State"] = "sim.state", ["Active"] = "sim.active", ["Lock"] = "sim.lock", ["Operator"] = "sim.operator", ["Operator Code"] = "sim.operator_code", ["IMSI"] = "sim.imsi", ["ICCID"] = "sim.iccid", ["EID"] = "sim.eid" } },
      ["Modem"] = { filter = "modem", keys = { ["State"] = "modem.state", ["Model"] = "modem.model", ["Manufacturer"] = "modem.manufacturer", ["Revision"] = "modem.revision", ["Failure"] = "modem.failure", ["Power"] = "modem.power", ["Plugin"] = "modem.plugin", ["Port"] = "modem.port", ["Equipment ID"] = "modem.equipment_id", ["IMEI"] = "modem.imei", ["MEID"] = "modem.meid", ["ESN"] = "modem.esn", ["Own Number"] = "modem.own_number" } },
    },
  },
  {
    name = "pallax_gsm", title = "GSM/UMTS", encapsulation = "USER1",
    framing = "record",
    codes = {
      [0x4005] = {
        name = "Ranking of UMTS and GSM cells",
        {
          head = { section = "UMTS Set", least = 15 },
          lists = {
            {
              layout = { key = "", start = 15, stride = 10, bytes_read = 10, count = { byte = 13, bit = 0, width = 8 }, plus = 0 },
              fields = {
                { key = "Scrambling Code", filter = "umts_set.scrambling_code", position = { byte = 2, bit = 0, width = 16 }, format = { number = "%d" } },
                { key = "RSCP", filter = "umts_set.rscp", position = { byte = 4, bit = 0, width = 8, signed = true }, format = { number = "%d", behind = " dB" }, offset = -21 },
                { key = "Energy Per Chip", filter = "umts_set.energy_per_chip", position = { byte = 7, bit = 0, width = 8, signed = true }, format = { number = "%f", behind = " dB", real = true, width = 0 }, factor = 0.5 },
                { key = "Downlink Frequency", filter = "umts_set.downlink_frequency", position = { byte = 0, bit = 0, width = 16, signed = true }, format = { number = "%d" } },
                { key = "Ranking Value", filter = "umts_set.ranking_value", position = { byte = 8, bit = 0, width = 16, signed = true }, format = { number = "%d" } },
                { key = "Rank Cell RSCP", filter = "umts_set.rank_cell_rscp", position = { byte = 5, bit = 0, width = 16, signed = true }, format = { number = "%d", behind = " dB" } },
              },
            },
          },
        },
        {
          head = { section = "GSM Set", least = 15 },
          lists = {
            {
              layout = { key = "", start = 15, stride = 7, bytes_read = 7, count = { byte = 14, bit = 0, width = 8 }, plus = 0 },
              fields = {
                { key = "ARFCN", filter = "gsm_set.arfcn", position = { byte = 0, bit = 0, width = 16 }, format = { number = "%d" } },
                { key = "BSIC", filter = "gsm_set.bsic", position = { byte = 2, bit = 0, width = 16 }, format = { number = "%d" } },
                { key = "RSSI", filter = "gsm_set.rssi", position = { byte = 4, bit = 0, width = 8, signed = true }, format = { number = "%d", behind = " dBm" } },
                { key = "Ranking Value", filter = "gsm_set.ranking_value", position = { byte = 5, bit = 0, width = 16, signed = true }, format = { number = "%d" } },
              },
            },
          },
        },
      },
      [0x4031] = {
        name = "Transmit power of UMTS",
        {
          head = { section = "UMTS RR Info", least = 16 },
          fields = {
            { key = "Transmit Power", filter = "umts_rr_info.transmit_power", computation = "mean power", formula = "the mean of (v + 512) / 10 toward zero - 70 over the entries whose raw power v is not 0; of none, it is no number", read = { { byte = 14, length = 1 } }, format = { number = "%4.2f", behind = " dBm", real = true, width = 4 } },
          },
          lists = {
            {
              layout = { key = "", start = 16, stride = 14, bytes_read = 6, count = { byte = 14, bit = 0, width = 8 }, plus = 0, hidden = true },
              fields = {
                { key = "", filter = "umts_rr_info", position = { byte = 4, bit = 0, width = 16, signed = true }, format = { number = "%d" } },
              },
            },
          },
        },
      },
      [0x4116] = {
        name = "Block errors of the transport channels",
        {
          head = { section = "BLER", least = 16 },
          fields = {
            { key = "Window Size", filter = "bler.window_size", position = { byte = 14, bit = 0, width = 16 }, format = { number = "%d" } },
          },
          lists = {
            {
              layout = { key = "Transport Channels", start = 16, stride = 9, bytes_read = 9, count = { byte = 13, bit = 0, width = 8 }, plus = 0 },
              fields = {
                { key = "Transport Channel ID", filter = "bler.transport_channels.transport_channel_id", position = { byte = 0, bit = 0, width = 8 }, format = { number = "%d" } },
                { key = "CRC Received", filter = "bler.transport_channels.crc_received", position = { byte = 1, bit = 0, width = 32, signed = true }, format = { number = "%d" } },
                { key = "CRC Received in Error", filter = "bler.transport_channels.crc_received_in_error", position = { byte = 5, bit = 0, width = 32, signed = true }, format = { number = "%d" } },
              },
            },
          },
        },
      },
      [0x4125] = {
        name = "State of the RRC connection",
        {
          head = { section = "UMTS RR Info", least = 14 },
          fields = {
            { key = "RRC State", filter = "umts_rr_info.rrc_state", position = { byte = 13, bit = 0, width = 8 }, labels = { [0] = "Disconnected", [1] = "Connecting", [2] = "CELL_FACH", [3] = "CELL_DCH", [4] = "CELL_PCH", [5] = "URA_PCH" }, beyond = "Unknown" },
          },
        },
      },
      [0x4127] = {
        name = "Identity of the UMTS serving cell",
        {
          head = { section = "UMTS RR Info", least = 29 },
          fields = {
            { key = "Cell ID", filter = "umts_rr_info.cell_id", position = { byte = 21, bit = 0, width = 32, signed = true }, format = { number = "%d" } },
            { key = "Downlink Frequency", filter = "umts_rr_info.downlink_frequency", position = { byte = 17, bit = 0, width = 32, signed = true }, format = { number = "%d" } },
            { key = "Uplink Frequency", filter = "umts_rr_info.uplink_frequency", position = { byte = 13, bit = 0, width = 32, signed = true }, format = { number = "%d" } },
            { key = "URA ID", filter = "umts_rr_info.ura_id", position = { byte = 25, bit = 0, width = 16 }, format = { number = "%d" } },
          },
        },
      },
      [0x4157] = {
        name = "Ciphering of UMTS",
        {
          head = { section = "UMTS RR Info", least = 19 },
          fields = {
            { key = "Ciphering", filter = "umts_rr_info.ciphering", position = { byte = 13, bit = 0, width = 8 }, labels = {  }, beyond = "Enabled", except = 0, except_text = "Disabled" },
          },
        },
      },
      [0x417A] = {
        name = "Cells of the UMTS searcher",
        {
          head = { section = "Active Set", least = 16 },
          lists = {
            {
              layout = { key = "", start = 16, stride = 15, bytes_read = 9, count = { byte = 15, bit = 0, width = 8 }, plus = 0, only = { position = { byte = 8, bit = 5, width = 3 }, least = 0, most = 0 }, companion = { start = 16, stride = 44, bytes_read = 44, move = 15, moved_by = { byte = 15, bit = 0, width = 8 } } },
              fields = {
                { key = "Scrambling Code", filter = "active_set.scrambling_code", position = { byte = 7, bit = 0, width = 13 }, format = { number = "%d" } },
                { key = "RSCP", filter = "active_set.rscp", computation = "rscp", formula = "(A + 512) / 10 toward zero - 106 + Energy Per Chip, A being the receive AGC, signed", read = { { byte = 32, length = 4, of = "companion" }, { byte = 36, length = 4, of = "companion" }, { byte = 40, length = 4, of = "companion" }, { byte = 13, length = 2, of = "record" } }, format = { number = "%d", behind = " dB" } },
                { key = "Energy Per Chip", filter = "active_set.energy_per_chip", computation = "ecno", formula = "whole dB of the first of the three energies of the cell's path that is not 0", read = { { byte = 32, length = 4, of = "companion" }, { byte = 36, length = 4, of = "companion" }, { byte = 40, length = 4, of = "companion" } }, format = { number = "%d", behind = " dB" } },
              },
            },
          },
        },
        {
          head = { section = "Monitored Set", least = 16 },
        },
        {
          head = { section = "Detected Set", least = 16 },
        },
        {
          head = { section = "Virtual Active Set", least = 16 },
        },
      },
      [0x4221] = {
        name = "HARQ processes of HSDPA",
        {
          head = { section = "HSDPA Info", least = 18 },
          fields = {
            { key = "Version", filter = "hsdpa_info.version", position = { byte = 13, bit = 0, width = 8 }, format = { number = "%d", unsigned = true } },
            { key = "Sub Frames", filter = "hsdpa_info.sub_frames", position = { byte = 14, bit = 0, width = 10 }, format = { number = "%d", unsigned = true } },
            { key = "Carrier Info", filter = "hsdpa_info.carrier_info", position = { byte = 15, bit = 2, width = 2 }, labels = { [0] = "Single Carrier", [1] = "MIMO", [2] = "Dual Carrier", [3] = "Reserved" }, beyond = "Unknown" },
          },
          lists = {
            {
              layout = { key = "Primary HARQ Process", start = 18, stride = 9, bytes_read = 9, count = { byte = 16, bit = 0, width = 8 }, plus = 0, stays_without_entries = true },
              fields = {
                { key = "Process ID", filter = "hsdpa_info.primary_harq_process.process_id", position = { byte = 0, bit = 0, width = 8 }, format = { number = "%d", unsigned = true } },
                { key = "No Rx Bits", filter = "hsdpa_info.primary_harq_process.no_rx_bits", position = { byte = 1, bit = 0, width = 32 }, format = { number = "%d", unsigned = true } },
                { key = "New Tx", filter = "hsdpa_info.primary_harq_process.new_tx", position = { byte = 5, bit = 0, width = 16 }, format = { number = "%d", unsigned = true } },
                { key = "Block Errors", filter = "hsdpa_info.primary_harq_process.block_errors", position = { byte = 7, bit = 0, width = 16 }, format = { number = "%d", unsigned = true } },
              },
            },
            {
              layout = { key = "Secondary HARQ Process", start = 18, stride = 9, bytes_read = 9, move = 162, moved_by = { byte = 16, bit = 0, width = 8 }, count = { byte = 17, bit = 0, width = 8 }, plus = 0, stays_without_entries = true },
              fields = {
                { key = "Process ID", filter = "hsdpa_info.secondary_harq_process.process_id", position = { byte = 0, bit = 0, width = 8 }, format = { number = "%d", unsigned = true } },
                { key = "No Rx Bits", filter = "hsdpa_info.secondary_harq_process.no_rx_bits", position = { byte = 1, bit = 0, width = 32 }, format = { number = "%d", unsigned = true } },
                { key = "New Tx", filter = "hsdpa_info.secondary_harq_process.new_tx", position = { byte = 5, bit = 0, width = 16 }, format = { number = "%d", unsigned = true } },
                { key = "Block Errors", filter = "hsdpa_info.secondary_harq_process.block_errors", position = { byte = 7, bit = 0, width = 16 }, format = { number = "%d", unsigned = true } },
              },
            },
          },
        },
      },
      [0x5072] = {
        name = "Discontinuous transmission",
        {
          head = { section = "GSM RR Info", least = 20 },
          fields = {
            { key = "DTX Used", filter = "gsm_rr_info.dtx_used", position = { byte = 19, bit = 0, width = 8 }, labels = {  }, beyond = "ON", except = 0, except_text = "OFF" },
          },
        },
      },
      [0x5076] = {
        name = "Dedicated channel of GSM",
        {
          head = { section = "GSM Serving Cell", least = 17 },
          fields = {
            { key = "MA Dedicated ARFCN", filter = "gsm_serving_cell.ma_dedicated_arfcn", position = { byte = 13, bit = 0, width = 8 }, format = { number = "%d" } },
          },
        },
      },
      [0x512C] = {
        name = "State of the GSM radio resource layer",
        {
          head = { section = "GSM RR Info", least = 17 },
          fields = {
            { key = "RR State", filter = "gsm_rr_info.rr_state", position = { byte = 13, bit = 0, width = 8 }, labels = { [0] = "RR_INACTIVE", [1] = "RR_GOING_ACTIVE", [2] = "RR_GOING_INACTIVE", [3] = "RR_CELL_SELECTION", [4] = "RR_PLMN_LIST_CONSTRUCTION", [5] = "RR_IDLE", [6] = "RR_CELL_RESELECTION", [7] = "RR_CONNECTION_PENDING", [8] = "RR_CHOOSE_CELL", [9] = "RR_DATA_TRANSFER", [10] = "RR_NO_CHANNELS", [11] = "RR_CONNECTION_RELEASE", [12] = "RR_EARLY_CAMPED_WAIT_FOR_SI", [13] = "RR_W2G_INTERRAT_HANDOVER_ PROGRESS", [14] = "RR_W2G_INTERRAT_RESELECTION_PROGRESS", [15] = "RR_WAIT_FOR_EARLY_PSCAN", [16] = "GRR51", [17] = "GRR52", [18] = "RR_G2W_INTERRAT_RESELECTION_PROGRESS", [19] = "RR_G2W_INTERRAT_HANDOVER_ PROGRESS", [20] = "RR_CELL_REEST", [21] = "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS" }, beyond = "Unknown" },
            { key = "RR Sub State", filter = "gsm_rr_info.rr_sub_state", position = { byte = 14, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "RR Status", filter = "gsm_rr_info.rr_status", position = { byte = 15, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "RR Mode", filter = "gsm_rr_info.rr_mode", position = { byte = 16, bit = 0, width = 8 }, labels = {  }, beyond = "Data", except = 0, except_text = "Voice" },
          },
        },
      },
      [0x5134] = {
        name = "Identity of the GSM serving cell",
        {
          head = { section = "GSM Serving Cell", least = 26 },
          fields = {
            { key = "Cell ID", filter = "gsm_serving_cell.cell_id", position = { byte = 17, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "ARFCN", filter = "gsm_serving_cell.arfcn", position = { byte = 13, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "BSIC", filter = "gsm_serving_cell.bsic", position = { byte = 15, bit = 0, width = 16 }, format = { number = "%d" } },
          },
        },
      },
      [0x5137] = {
        name = "Measurement of the GSM serving cell and its neighbours",
        {
          head = { section = "GSM Serving Cell", least = 29 },
          fields = {
            { key = "RSSI", filter = "gsm_serving_cell.rssi", position = { byte = 15, bit = 0, width = 8 }, format = { number = "%d", behind = " dBm" } },
            { key = "C1 Value", filter = "gsm_serving_cell.c1_value", position = { byte = 16, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "C2 Value", filter = "gsm_serving_cell.c2_value", position = { byte = 20, bit = 0, width = 16 }, format = { number = "%d" } },
          },
        },
        {
          head = { section = "GSM RR Info", least = 29 },
          fields = {
            { key = "Serving Rx Level", filter = "gsm_rr_info.serving_rx_level", position = { byte = 15, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "Rx Quality Full", filter = "gsm_rr_info.rx_quality_full", position = { byte = 16, bit = 0, width = 32, signed = true }, format = { number = "%d" } },
            { key = "Rx Quality Sub", filter = "gsm_rr_info.rx_quality_sub", position = { byte = 20, bit = 0, width = 32, signed = true }, format = { number = "%d" } },
          },
        },
        {
          head = { section = "Neighboring Cells", least = 29 },
          lists = {
            {
              layout = { key = "", start = 29, stride = 14, bytes_read = 7, count = { byte = 28, bit = 0, width = 8 }, plus = 0 },
              fields = {
                { key = "ARFCN", filter = "neighboring_cells.arfcn", position = { byte = 0, bit = 0, width = 16 }, format = { number = "%d" } },
                { key = "RSSI", filter = "neighboring_cells.rssi", position = { byte = 2, bit = 0, width = 8 }, format = { number = "%d" } },
                { key = "C1 Value", filter = "neighboring_cells.c1_value", position = { byte = 3, bit = 0, width = 32, signed = true }, format = { number = "%d" } },
                { key = "BSIC", filter = "neighboring_cells.bsic", computation = "bsic", formula = "what the last record 0x51FF told for the ARFCN; no key if nothing", read = { { byte = 0, length = 2 } }, format = { number = "%d" } },
              },
            },
          },
        },
        {
          head = { section = "GPRS Information", least = 29 },
          fields = {
            { key = "Cell Reselect Hysteresis", filter = "gprs_information.cell_reselect_hysteresis", position = { byte = 26, bit = 0, width = 8 }, labels = {  }, beyond = "Applied", except = 0, except_text = "Not Applied" },
          },
        },
      },
      [0x51F4] = {
        name = "Position of system information 13",
        {
          head = { section = "GPRS Information", least = 15 },
          fields = {
            { key = "SI13 Position", filter = "gprs_information.si13_position", position = { byte = 14, bit = 0, width = 8 }, labels = { [0] = "Not Available", [1] = "Located on BCCH", [2] = "Located on Extended BCCH" }, shift = 1, beyond = "Unknown" },
          },
        },
      },
      [0x51F5] = {
        name = "Packet control parameters",
        {
          head = { section = "GPRS Information", least = 18 },
          fields = {
            { key = "Network Control Order", filter = "gprs_information.network_control_order", position = { byte = 15, bit = 0, width = 8 }, labels = { [0] = "Not Available", [1] = "NC0", [2] = "NC1", [3] = "NC2" }, shift = 1, beyond = "Unknown" },
            { key = "PFC Supported", filter = "gprs_information.pfc_supported", position = { byte = 13, bit = 0, width = 8 }, labels = { [0] = "Available", [1] = "Not Supported", [2] = "Supported" }, shift = 1, beyond = "Unknown" },
            { key = "Priority Access Threshold", filter = "gprs_information.priority_access_threshold", position = { byte = 14, bit = 0, width = 8 }, labels = { [0] = "Not Available", [1] = "Barred (PKT access not allowed in the Cell)", [2] = "Barred", [3] = "Barred", [4] = "1 Only", [5] = "1 to 2", [6] = "1 to 3", [7] = "1 to 4", [8] = "Allowed" }, shift = 1, beyond = "Unknown" },
          },
        },
      },
      [0x51F6] = {
        name = "Packet timers and discontinuous reception",
        {
          head = { section = "GSM RR Info", least = 24 },
          fields = {
            { key = "DRX Used", filter = "gsm_rr_info.drx_used", position = { byte = 16, bit = 0, width = 8 }, format = { number = "%d", behind = " sec" } },
          },
        },
        {
          head = { section = "GPRS Information", least = 24 },
          fields = {
            { key = "T3192", filter = "gprs_information.t3192", position = { byte = 15, bit = 0, width = 8 }, labels = { [0] = "500 ms", [1] = "1000 ms", [2] = "1500 ms", [3] = "0 ms", [4] = "80 ms", [5] = "120 ms", [6] = "160 ms", [7] = "200 ms" }, beyond = "?? ms" },
            { key = "Access Burst Type", filter = "gprs_information.access_burst_type", position = { byte = 17, bit = 0, width = 8 }, labels = {  }, beyond = "11-bit format", except = 0, except_text = "8-bit format" },
            { key = "DRX Timer Max", filter = "gprs_information.drx_timer_max", position = { byte = 16, bit = 0, width = 8 }, format = { number = "%d" } },
          },
        },
      },
      [0x51F8] = {
        name = "Mobile allocation",
        {
          head = { section = "Mobile Allocation", least = 15 },
          fields = {
            { key = "HSN", filter = "mobile_allocation.hsn", position = { byte = 13, bit = 0, width = 8 }, format = { number = "%d" } },
          },
          lists = {
            {
              layout = { key = "ARFCNs", start = 15, stride = 2, bytes_read = 2, count = { byte = 14, bit = 0, width = 8 }, plus = 0 },
              fields = {
                { key = "", filter = "mobile_allocation.arfcns", position = { byte = 0, bit = 0, width = 16 }, format = { number = "%d" } },
              },
            },
          },
        },
      },
      [0x51FB] = {
        name = "Packet broadcast channel",
        {
          head = { section = "GPRS Information", least = 34 },
          fields = {
            { key = "PBCCH Present", filter = "gprs_information.pbcch_present", position = { byte = 13, bit = 0, width = 8 }, format = { number = "%d" } },
          },
        },
      },
      [0x51FD] = {
        name = "Extended measurement and packet status",
        {
          head = { section = "GPRS Information", least = 35 },
          fields = {
            { key = "Ext Measurement Order", filter = "gprs_information.ext_measurement_order", position = { byte = 16, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "Packet PSI Status", filter = "gprs_information.packet_psi_status", position = { byte = 13, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "Packet SI Status", filter = "gprs_information.packet_si_status", position = { byte = 33, bit = 0, width = 8 }, labels = {  }, beyond = "Supported", except = 0, except_text = "Not Supported" },
            { key = "Count LR", filter = "gprs_information.count_lr", position = { byte = 14, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "Count HR", filter = "gprs_information.count_hr", position = { byte = 15, bit = 0, width = 8 }, format = { number = "%d" } },
          },
        },
      },
      [0x51FF] = {
        name = "Identity codes of the GSM neighbours",
        {
          head = { section = "Neighboring Cells", least = 15 },
          lists = {
            {
              layout = { key = "", start = 15, stride = 4, bytes_read = 3, count = { byte = 14, bit = 0, width = 8 }, plus = 0, hidden = true, remembered_as = "bsic" },
              fields = {
                { key = "ARFCN", filter = "neighboring_cells.arfcn", position = { byte = 0, bit = 0, width = 16 }, format = { number = "%d" } },
                { key = "BSIC", filter = "neighboring_cells.bsic", position = { byte = 2, bit = 0, width = 8 }, format = { number = "%d" } },
              },
            },
          },
        },
      },
      [0x7130] = {
        name = "State of GPRS mobility management",
        {
          head = { section = "Process PS", least = 16 },
          fields = {
            { key = "MM State", filter = "process_ps.mm_state", position = { byte = 13, bit = 0, width = 8 }, labels = { [0] = "GMM_NULL", [1] = "GMM_DEREGISTERED", [2] = "GMM_REGISTERED_INITIATED", [3] = "GMM_REGISTERED", [4] = "GMM_DEREGISTERED_INITIATED", [5] = "GMM_ROUTING_AREA_UPDATE_INITIATED", [6] = "GMM_SERVICE_REQUEST_INITIATED" }, beyond = "Unknown" },
            { key = "MM Sub State", filter = "process_ps.mm_sub_state", position = { byte = 14, bit = 0, width = 8 }, labels = { [0] = "GMM_NORMAL_SERVICE", [1] = "GMM_LIMITED_SERVICE", [2] = "GMM_ATTACH_NEEDED", [3] = "GMM_ATTEMPTING_TO_ATTACH", [4] = "GMM_NO_IMSI", [5] = "GMM_NO_CELL_AVAILABLE", [6] = "GMM_PLMN_SEARCH", [7] = "GMM_SUSPENDED", [8] = "GMM_UPDATE_NEEDED", [9] = "GMM_ATTEMPING_TO_UPDATE", [10] = "GMM_ATTEMPTING_TO_UPDATE_MM", [11] = "GMM_IMSI_DETACH_INITIATED", [12] = "GMM_NULL_SUBSTATE" }, beyond = "Unknown" },
            { key = "Attach Reject Cause", filter = "process_ps.attach_reject_cause", position = { byte = 15, bit = 0, width = 8 }, labels = { [0] = "GMM_GU1_UPDATED", [1] = "GMM_GU2_NOT_UPDATED", [2] = "GMM_GU3_PLMN_NOT_ALLOWED", [3] = "GMM_GU3_ROUTING_AREA_NOT_ALLOWED" }, beyond = "Unknown" },
          },
        },
      },
      [0x7131] = {
        name = "State of mobility management",
        {
          head = { section = "Process CO", least = 16 },
          fields = {
            { key = "MM State", filter = "process_co.mm_state", position = { byte = 13, bit = 0, width = 8 }, labels = { [0] = "MM_NULL", [3] = "MM_LOCATION_UPDATE_INITIATED", [5] = "MM_WAIT_FOR_OUTGOING_MM_CONNECTION", [6] = "MM_CONNECTION_ACTIVE", [7] = "MM_IMSI_DETACH_INITIATED", [8] = "MM_PROCESS_CM_SERVICE_PROMPT", [9] = "MM_WAIT_FOR_NETWORK_COMMAND", [10] = "MM_LOCATION_UPDATE_REJECTED", [13] = "MM_WAIT_FOR_RR_CONNECTION_LU", [14] = "MM_WAIT_FOR_RR_CONNECTION_MM", [15] = "MM_WAIT_FOR_RR_CONNECTION_IMSI_DETACH", [17] = "MM_REESTABLISHMENT_INITIATED", [18] = "MM_WAIT_FOR_RR_ACTIVE", [19] = "MM_IDLE", [20] = "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION", [21] = "MM_WAIT_FOR_RR_CONNECTION_ REESTABLISHMENT", [22] = "MM_WAIT_FOR_REESTABLISH_DECISION", [23] = "MM_LOCATION_UPDATING_PENDING", [25] = "MM_RR_CONNECTION_RELEASE_NOT_ALLOWED" }, beyond = "Unknown" },
          },
        },
        {
          head = { section = "Process CS", least = 16 },
          fields = {
            { key = "MM State", filter = "process_cs.mm_state", position = { byte = 13, bit = 0, width = 8 }, labels = { [0] = "MM_NULL", [3] = "MM_LOCATION_UPDATE_INITIATED", [5] = "MM_WAIT_FOR_OUTGOING_MM_CONNECTION", [6] = "MM_CONNECTION_ACTIVE", [7] = "MM_IMSI_DETACH_INITIATED", [8] = "MM_PROCESS_CM_SERVICE_PROMPT", [9] = "MM_WAIT_FOR_NETWORK_COMMAND", [10] = "MM_LOCATION_UPDATE_REJECTED", [13] = "MM_WAIT_FOR_RR_CONNECTION_LU", [14] = "MM_WAIT_FOR_RR_CONNECTION_MM", [15] = "MM_WAIT_FOR_RR_CONNECTION_IMSI_DETACH", [17] = "MM_REESTABLISHMENT_INITIATED", [18] = "MM_WAIT_FOR_RR_ACTIVE", [19] = "MM_IDLE", [20] = "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION", [21] = "MM_WAIT_FOR_RR_CONNECTION_ REESTABLISHMENT", [22] = "MM_WAIT_FOR_REESTABLISH_DECISION", [23] = "MM_LOCATION_UPDATING_PENDING", [25] = "MM_RR_CONNECTION_RELEASE_NOT_ALLOWED" }, beyond = "Unknown" },
            { key = "MM Sub State", filter = "process_cs.mm_sub_state", position = { byte = 14, bit = 0, width = 8 }, labels = { [0] = "MM_NULL_SUBSTATE", [1] = "MM_NO_IMSI", [2] = "MM_PLMN_SEARCH", [3] = "MM_LIMITED_SERVICE", [4] = "MM_ATTEMPTING_TO_UPDATE", [5] = "MM_LOCATION_UPDATE_NEEDED", [6] = "MM_NO_CELL_AVAILABLE", [7] = "MM_PLMN_SEARCH_NORMAL_SERVICE", [8] = "MM_NORMAL_SERVICE" }, beyond = "Unknown" },
            { key = "LU Reject Cause", filter = "process_cs.lu_reject_cause", position = { byte = 15, bit = 0, width = 8 }, labels = { [0] = "UPDATED", [1] = "NOT_UPDATED", [2] = "ROAMING_NOT_ALLOWED", [3] = "LOCATION_AREA_NOT_ALLOWED" }, beyond = "Unknown" },
          },
        },
      },
      [0x7132] = {
        name = "State of the registration",
        {
          head = { section = "Serving PLMN", least = 16 },
          fields = {
            { key = "PLMN Sel Mod", filter = "serving_plmn.plmn_sel_mod", position = { byte = 14, bit = 0, width = 8 }, labels = { [0] = "Automatic", [1] = "Manual", [2] = "Limited", [3] = "LIMITED_ROUTINE_ACQ", [4] = "LIMITED_MANUAL_ACQ" }, beyond = "Unknown" },
          },
        },
        {
          head = { section = "Process CO", least = 16 },
          fields = {
            { key = "MM Service State", filter = "process_co.mm_service_state", position = { byte = 13, bit = 0, width = 8 }, labels = { [0] = "REG_STATE_INACTIVE", [1] = "REG_STATE_IDLE", [2] = "REG_STATE_REGISTERING", [3] = "REG_STATE_DEREGISTERING", [4] = "REG_STATE_MANUAL_SEARCH", [5] = "REG_STATE_AUTOMATIC_SEARCH", [6] = "REG_STATE_OFFLINE" }, beyond = "Unknown" },
          },
        },
        {
          head = { section = "Process CS", least = 16 },
          fields = {
            { key = "MM Service State", filter = "process_cs.mm_service_state", position = { byte = 13, bit = 0, width = 8 }, labels = { [0] = "REG_STATE_INACTIVE", [1] = "REG_STATE_IDLE", [2] = "REG_STATE_REGISTERING", [3] = "REG_STATE_DEREGISTERING", [4] = "REG_STATE_MANUAL_SEARCH", [5] = "REG_STATE_AUTOMATIC_SEARCH", [6] = "REG_STATE_OFFLINE" }, beyond = "Unknown" },
          },
        },
        {
          head = { section = "Process PS", least = 16 },
          fields = {
            { key = "MM Service State", filter = "process_ps.mm_service_state", position = { byte = 13, bit = 0, width = 8 }, labels = { [0] = "REG_STATE_INACTIVE", [1] = "REG_STATE_IDLE", [2] = "REG_STATE_REGISTERING", [3] = "REG_STATE_DEREGISTERING", [4] = "REG_STATE_MANUAL_SEARCH", [5] = "REG_STATE_AUTOMATIC_SEARCH", [6] = "REG_STATE_OFFLINE" }, beyond = "Unknown" },
          },
        },
      },
      [0x7135] = {
        name = "Serving network",
        {
          head = { section = "Serving PLMN", least = 32 },
          fields = {
            { key = "Mobile Country Code", filter = "serving_plmn.mobile_country_code", computation = "country code", formula = "three digits: low and high half of the first byte, low half of the second; a blank for one above 9", read = { { byte = 15, length = 1 }, { byte = 16, length = 1 } }, labels = {  }, beyond = "" },
            { key = "Mobile Network Code", filter = "serving_plmn.mobile_network_code", computation = "network code", formula = "three digits: low and high half of the first byte, high half of the second; a blank for one above 9", read = { { byte = 17, length = 1 }, { byte = 16, length = 1 } }, labels = {  }, beyond = "" },
            { key = "Location Area Code", filter = "serving_plmn.location_area_code", position = { byte = 18, bit = 0, width = 16, big = true }, format = { number = "%d" } },
            { key = "Routing Area Code", filter = "serving_plmn.routing_area_code", position = { byte = 20, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "Service Type", filter = "serving_plmn.service_type", position = { byte = 14, bit = 0, width = 8 }, labels = { [0] = "NO_SERVICE", [1] = "CS_ONLY", [2] = "PS_ONLY", [3] = "CS_PS_SERVICE", [4] = "LIMITED_SERVICE" }, beyond = "Unknown" },
          },
        },
        {
          head = { section = "GPRS Information", least = 32 },
          fields = {
            { key = "Network Operating Mode", filter = "gprs_information.network_operating_mode", position = { byte = 13, bit = 0, width = 8 }, labels = { [0] = "Class 1", [1] = "Class 2", [2] = "Class 3" }, beyond = "Unknown" },
          },
        },
      },
      [0x7150] = {
        name = "Equivalent networks",
        {
          head = { section = "Equivalent PLMN List", least = 17 },
          lists = {
            {
              layout = { key = "", start = 17, stride = 3, bytes_read = 6, count = { byte = 16, bit = 0, width = 8 }, plus = 0 },
              fields = {
                { key = "Mobile Country Code", filter = "equivalent_plmn_list.mobile_country_code", computation = "digits", formula = "100 x the first byte + 10 x the second + the third", read = { { byte = 0, length = 1 }, { byte = 2, length = 1 }, { byte = 4, length = 1 } }, format = { number = "%d" } },
                { key = "Mobile Network Code", filter = "equivalent_plmn_list.mobile_network_code", computation = "digits", formula = "100 x the first byte + 10 x the second + the third", read = { { byte = 1, length = 1 }, { byte = 3, length = 1 }, { byte = 5, length = 1 } }, format = { number = "%d" } },
              },
            },
          },
        },
      },
      [0xFF0000] = {
        name = "SIM files",
        {
          head = { section = "SIM Info", least = 0 },
          list = { part = "keys" },
          fields = {
            { key = "EF-ICCID", filter = "sim_info.ef_iccid", list_key = "kSimFile_ICCID" },
            { key = "EF-MSISDN", filter = "sim_info.ef_msisdn", list_key = "kSimFile_MSISDN" },
            { key = "EF-3GPP MAIL BOX DIALING NUMBER", filter = "sim_info.ef_3gpp_mail_box_dialing_number", list_key = "kSimFile_MBDN" },
            { key = "EF-HPPLMN SEARCH PERIOD", filter = "sim_info.ef_hpplmn_search_period", list_key = "kSimFile_HPPLMN" },
            { key = "EF-LOCI", filter = "sim_info.ef_loci", list_key = "kSimFile_LOCI" },
            { key = "EF-GPRS/PS-LOCI", filter = "sim_info.ef_gprs_ps_loci", list_key = "kSimFile_PSLOCI" },
            { key = "EF-ACCESS CONTROL CLASS", filter = "sim_info.ef_access_control_class", list_key = "kSimFile_ACC" },
            { key = "EF-ADMINISTRATIVE DATA", filter = "sim_info.ef_administrative_data", list_key = "kSimFile_AD" },
            { key = "EF-FPLMN", filter = "sim_info.ef_fplmn", list_key = "kSimFile_FPLMN" },
            { key = "EF-ACTING HPLMN", filter = "sim_info.ef_acting_hplmn", list_key = "kSimFile_AHPLMN" },
            { key = "EF-RAT MODE", filter = "sim_info.ef_rat_mode", list_key = "kSimFile_RATMODE" },
            { key = "EF-PLMN NETWORK NAME", filter = "sim_info.ef_plmn_network_name", list_key = "kSimFile_PNN" },
            { key = "EF-OPERATOR PLMN LIST", filter = "sim_info.ef_operator_plmn_list", list_key = "kSimFile_OPL" },
            { key = "EF-OPLMNAcT", filter = "sim_info.ef_oplmnact", list_key = "kSimFile_OPLMNAcT" },
          },
        },
      },
      [0xFF0001] = {
        name = "Cell monitor",
        {
          head = { section = "Serving PLMN", least = 0 },
          list = { part = "first cell", technologies = { "kHXCellMonitorRadioAccessTechnologyGSM", "kHXCellMonitorRadioAccessTechnologyUMTS" }, cell_type = "kHXCellMonitorCellTypeServing" },
          fields = {
            { key = "Mobile Country Code", filter = "serving_plmn.mobile_country_code", list_key = "kHXCellMonitorMCC", format = { number = "%d" } },
            { key = "Mobile Network Code", filter = "serving_plmn.mobile_network_code", list_key = "kHXCellMonitorMNC", format = { number = "%d" } },
            { key = "Location Area Code", filter = "serving_plmn.location_area_code", list_key = "kHXCellMonitorLAC", format = { number = "%d" } },
          },
        },
        {
          head = { section = "GSM Serving Cell", least = 0 },
          list = { part = "first cell", technologies = { "kHXCellMonitorRadioAccessTechnologyGSM" }, cell_type = "kHXCellMonitorCellTypeServing" },
          fields = {
            { key = "Cell ID", filter = "gsm_serving_cell.cell_id", list_key = "kHXCellMonitorCellId", format = { number = "%d" } },
            { key = "ARFCN", filter = "gsm_serving_cell.arfcn", list_key = "kHXCellMonitorARFCN", format = { number = "%d" } },
          },
        },
        {
          head = { section = "Neighboring Cells", least = 0 },
          list = { part = "cell entries", technologies = { "kHXCellMonitorRadioAccessTechnologyGSM" }, cell_type = "kHXCellMonitorCellTypeNeighbor" },
          fields = {
            { key = "ARFCN", filter = "neighboring_cells.arfcn", list_key = "kHXCellMonitorARFCN", format = { number = "%d" } },
            { key = "RSSI", filter = "neighboring_cells.rssi", list_key = "kHXCellMonitorRSSI", low_bits = 16, format = { number = "%d", behind = " dBm" }, factor = 2, except = 32767, except_text = "" },
          },
        },
        {
          head = { section = "UMTS RR Info", least = 0 },
          list = { part = "first cell", technologies = { "kHXCellMonitorRadioAccessTechnologyUMTS" }, cell_type = "kHXCellMonitorCellTypeServing" },
          fields = {
            { key = "Cell ID", filter = "umts_rr_info.cell_id", list_key = "kHXCellMonitorCellId", format = { number = "%d" } },
            { key = "UARFCN", filter = "umts_rr_info.uarfcn", list_key = "kHXCellMonitorUARFCN", format = { number = "%d" } },
            { key = "Scrambling Code", filter = "umts_rr_info.scrambling_code", list_key = "kHXCellMonitorSCN", format = { number = "%d" } },
          },
        },
        {
          head = { section = "UMTS Set", least = 0 },
          list = { part = "cell entries", technologies = { "kHXCellMonitorRadioAccessTechnologyUMTS" }, cell_type = "kHXCellMonitorCellTypeNeighbor" },
          fields = {
            { key = "UARFCN", filter = "umts_set.uarfcn", list_key = "kHXCellMonitorUARFCN", format = { number = "%d" } },
            { key = "Scrambling Code", filter = "umts_set.scrambling_code", list_key = "kHXCellMonitorSCN", format = { number = "%d" } },
            { key = "RSCP", filter = "umts_set.rscp", list_key = "kHXCellMonitorRSCP", low_bits = 16, format = { number = "%d", behind = " dBm" }, except = 32767, except_text = "" },
            { key = "Energy Per Chip", filter = "umts_set.energy_per_chip", list_key = "kHXCellMonitorECN0", low_bits = 16, format = { number = "%d", behind = " dB" }, except = 32767, except_text = "" },
          },
        },
      },
      [0xFF0002] = {
        name = "Contexts of packet data",
        {
          head = { section = "PDP Context Info", least = 0 },
          list = { part = "elements" },
        },
      },
    },
  },
  {
    name = "pallax_cdma", title = "CDMA", encapsulation = "USER2",
    framing = "any type",
    codes = {
      [0x108A] = {
        name = "Fingers of the EV-DO receiver",
        {
          head = { section = "EV-DO", least = 23 },
          lists = {
            {
              layout = { key = "Finger C2I", start = 23, stride = 14, bytes_read = 14, count = { byte = 22, bit = 0, width = 8 }, plus = 0, fit = "exact", only = { position = { byte = 0, bit = 0, width = 16 }, least = 0, most = 65534 }, entry_name = { byte = 0, bit = 0, width = 16 } },
              fields = {
                { key = "", filter = "ev_do.finger_c2i", computation = "energy", formula = "10 x log10(raw / 512)", read = { { byte = 6, length = 2 } }, format = { number = "%+.2f", behind = " dB", real = true, width = 0 } },
              },
            },
          },
        },
      },
      [0x1183] = {
        name = "State of EV-DO",
        {
          head = { section = "EV-DO", least = 50, exact = true },
          fields = {
            { key = "Channel", filter = "ev_do.channel", position = { byte = 13, bit = 0, width = 11 }, format = { number = "%d" } },
            { key = "Device State", filter = "ev_do.device_state", position = { byte = 36, bit = 0, width = 8 }, labels = { [0] = "Inactive [0]", [1] = "Acquisition [1]", [2] = "Sync [2]", [3] = "Idle [3]", [4] = "Access [4]", [5] = "Connected [5]" }, beyond_format = { number = "%d", before = "[Reserved ", behind = "]" } },
            { key = "Band Class", filter = "ev_do.band_class", position = { byte = 14, bit = 3, width = 5 }, labels = { [0] = "800 MHz cellular band [0]", [1] = "1.8 to 2.0GHz PCS band [1]", [2] = "872 to 960MHz TACS band [2]", [3] = "832 to 925MHz JTACS band [3]", [4] = "1.75 to 1.87GHz Korean PCS band [4]", [5] = "450MHz band [5]", [6] = "2GHz band [6]", [7] = "700MHz band [7]", [8] = "1800 MHz band [8]", [9] = "900 MHzband [9]", [10] = "Secondary 800 MHz band [10]", [11] = "400 MHz European PAMR band [11]", [12] = "800 MHz European PAMR band [12]" }, beyond_format = { number = "%d", before = "[Bad Value ", behind = "]" } },
            { key = "Receive AGC 0", filter = "ev_do.receive_agc_0", position = { byte = 15, bit = 0, width = 8, signed = true }, format = { number = "%+d", behind = " dBm" } },
            { key = "Receive AGC 1", filter = "ev_do.receive_agc_1", position = { byte = 16, bit = 0, width = 8, signed = true }, format = { number = "%+d", behind = " dBm" }, condition = { position = { byte = 36, bit = 0, width = 8 }, least = 4, most = 255, otherwise = "N/A" } },
            { key = "Transmit AGC", filter = "ev_do.transmit_agc", position = { byte = 17, bit = 0, width = 8, signed = true }, format = { number = "%+d", behind = " dBm" }, condition = { position = { byte = 36, bit = 0, width = 8 }, least = 4, most = 255, otherwise = "N/A" } },
            { key = "Serving PN Offset", filter = "ev_do.serving_pn_offset", position = { byte = 18, bit = 0, width = 16 }, format = { number = "%d", behind = " × 64chips" }, except = 65535, except_text = "Invalid Value" },
            { key = "Session State", filter = "ev_do.session_state", position = { byte = 37, bit = 0, width = 8 }, labels = { [0] = "Closed [0]", [1] = "AMP setup [1]", [2] = "AT-initiated neg [2]", [3] = "Initiated neg [3]", [4] = "Open [4]" }, beyond_format = { number = "%d", before = "[Reserved ", behind = "]" } },
            { key = "UATI24", filter = "ev_do.uati24", position = { byte = 38, bit = 0, width = 24 }, format = { number = "%06x", before = "0x", unsigned = true } },
            { key = "Color Code", filter = "ev_do.color_code", position = { byte = 41, bit = 0, width = 8 }, format = { number = "%d" } },
          },
        },
      },
      [0x1192] = {
        name = "Counters of the EV-DO forward link",
        {
          head = { section = "Data Rates", least = 241 },
          fields = {
            { key = "Forward Link", filter = "data_rates.forward_link", computation = "data rate", formula = "growth of the weighted sum of the counters since the packet before, divided by 1024 x the growth of the sequence number; empty at the first packet, unchanged where the number has not grown", read = { { byte = 13, length = 4 }, { byte = 17, length = 224 } }, counters = { { 17, 128 }, { 21, 256 }, { 25, 512 }, { 29, 1024 }, { 37, 128 }, { 41, 256 }, { 45, 512 }, { 49, 1024 }, { 57, 128 }, { 61, 256 }, { 65, 512 }, { 69, 1024 }, { 77, 128 }, { 81, 256 }, { 85, 512 }, { 89, 1024 }, { 97, 128 }, { 101, 256 }, { 105, 512 }, { 109, 1024 }, { 117, 512 }, { 121, 1024 }, { 125, 2048 }, { 133, 128 }, { 137, 256 }, { 141, 512 }, { 145, 1024 }, { 153, 512 }, { 157, 1024 }, { 161, 2048 }, { 169, 1024 }, { 173, 3072 }, { 181, 512 }, { 185, 1024 }, { 189, 2048 }, { 197, 4096 }, { 205, 1024 }, { 209, 3072 }, { 217, 4096 }, { 225, 5120 }, { 233, 5120 } }, format = { number = "%.2f", behind = " kbps", real = true, width = 0 } },
          },
        },
      },
      [0x119C] = {
        name = "State of the 1x device",
        {
          head = { section = "1x", least = 17 },
          subpackets = {
            {
              id = 1,
              fields = {
                { key = "Device State", filter = "1x.device_state", position = { byte = 4, bit = 0, width = 8 }, labels = { [0] = "Inactive [0]", [1] = "Deep sleep in start state [1]", [2] = "Initial state for CDMA operation [2]", [3] = "Acquisition [3]", [4] = "Sync [4]", [5] = "Slew [5]", [6] = "Paging [6]", [7] = "Slotted mode sleep state [7]", [8] = "Traffic [8]", [9] = "UnSlew [9]", [10] = "Operation in PCG state [10]", [11] = "Powerup state [11]" }, beyond_format = { number = "%d", before = "[Bad Value ", behind = "]" } },
                { key = "Frame Error Rate", filter = "1x.frame_error_rate", computation = "old frame errors", formula = "outside Traffic, once: the average of the call that is over", read = { { byte = 4, length = 1 } }, format = { number = "%.2f", behind = "% (old)", real = true, width = 0 } },
              },
            },
            {
              id = 2,
              fields = {
                { key = "Transmit AGC", filter = "1x.transmit_agc", position = { byte = 12, bit = 0, width = 16, signed = true }, format = { number = "%+.2f", behind = " dBm", real = true, width = 0 }, factor = 0.1, condition = { position = { byte = 4, bit = 0, width = 8 }, least = 8, most = 8, otherwise = "N/A", subpacket = 1 } },
              },
            },
            {
              id = 3,
              lists = {
                {
                  layout = { key = "Active Set", start = 0, stride = 0, bytes_read = 0, count = { byte = 8, bit = 0, width = 8 }, plus = 0, entry_name = { byte = 12, bit = 0, width = 16 }, varying = true },
                  fields = {
                    { key = "", filter = "1x.active_set", computation = "scaled energy", formula = "10 x log10 of 2^(2e - 3) x E / (9 x N^2 x g) - 1 / N, at least 0.00001: E, 16 bits, at 4m + 24 of the pilot, N, 16 bits, at 4, g at 6 and e at 7 of the subpacket; for the pilot whose PN is the reference, the 16 bits at byte 10 of the subpacket, as \"(ref pilot) %+.2f dB\", for the others", read = { { byte = 4, length = 2 }, { byte = 6, length = 1 }, { byte = 7, length = 1 }, { byte = 9, length = 1 }, { byte = 10, length = 2 } }, format = { number = "%+.2f", behind = " dB", real = true, width = 0 } },
                  },
                },
              },
            },
            {
              id = 4,
            },
          },
        },
        {
          head = { section = "1x / Receiver 0", least = 17 },
          subpackets = {
            {
              id = 1,
            },
            {
              id = 2,
              fields = {
                { key = "Band Class", filter = "1x_receiver_0.band_class", position = { byte = 4, bit = 0, width = 8 }, labels = { [0] = "800 MHz cellular band [0]", [1] = "1.8 to 2.0GHz PCS band [1]", [2] = "872 to 960MHz TACS band [2]", [3] = "832 to 925MHz JTACS band [3]", [4] = "1.75 to 1.87GHz Korean PCS band [4]", [5] = "450MHz band [5]", [6] = "2GHz band [6]", [7] = "700MHz band [7]", [8] = "1800 MHz band [8]", [9] = "900 MHzband [9]", [10] = "Secondary 800 MHz band [10]", [11] = "400 MHz European PAMR band [11]", [12] = "800 MHz European PAMR band [12]" }, beyond_format = { number = "%d", before = "[Bad Value ", behind = "]" } },
                { key = "Channel", filter = "1x_receiver_0.channel", position = { byte = 6, bit = 0, width = 16 }, format = { number = "%d" } },
                { key = "AGC", filter = "1x_receiver_0.agc", position = { byte = 10, bit = 0, width = 8, signed = true }, format = { number = "%+.2f", behind = " dBm", real = true, width = 0 }, factor = 0.334, offset = -63.248 },
              },
            },
            {
              id = 3,
            },
            {
              id = 4,
            },
          },
        },
        {
          head = { section = "1x / Receiver 1", least = 17 },
          subpackets = {
            {
              id = 1,
            },
            {
              id = 2,
              fields = {
                { key = "Band Class", filter = "1x_receiver_1.band_class", position = { byte = 5, bit = 0, width = 8 }, labels = { [0] = "800 MHz cellular band [0]", [1] = "1.8 to 2.0GHz PCS band [1]", [2] = "872 to 960MHz TACS band [2]", [3] = "832 to 925MHz JTACS band [3]", [4] = "1.75 to 1.87GHz Korean PCS band [4]", [5] = "450MHz band [5]", [6] = "2GHz band [6]", [7] = "700MHz band [7]", [8] = "1800 MHz band [8]", [9] = "900 MHzband [9]", [10] = "Secondary 800 MHz band [10]", [11] = "400 MHz European PAMR band [11]", [12] = "800 MHz European PAMR band [12]" }, beyond_format = { number = "%d", before = "[Bad Value ", behind = "]" }, condition = { position = { byte = 4, bit = 0, width = 8 }, least = 8, most = 8, otherwise = "N/A", subpacket = 1 } },
                { key = "Channel", filter = "1x_receiver_1.channel", position = { byte = 8, bit = 0, width = 16 }, format = { number = "%d" }, condition = { position = { byte = 4, bit = 0, width = 8 }, least = 8, most = 8, otherwise = "N/A", subpacket = 1 } },
                { key = "AGC", filter = "1x_receiver_1.agc", position = { byte = 11, bit = 0, width = 8, signed = true }, format = { number = "%+.2f", behind = " dBm", real = true, width = 0 }, factor = 0.334, offset = -63.248, condition = { position = { byte = 4, bit = 0, width = 8 }, least = 8, most = 8, otherwise = "N/A", subpacket = 1 } },
              },
            },
            {
              id = 3,
            },
            {
              id = 4,
            },
          },
        },
      },
      [0x119D] = {
        name = "Frames of the 1x traffic channel",
        {
          head = { section = "1x", least = 17 },
          subpackets = {
            {
              id = 11,
              fields = {
                { key = "Frame Error Rate", filter = "1x.frame_error_rate", computation = "frame errors", formula = "a frame is in error unless the byte is 0; of the call's frames so far the average in which the newest has a weight of 1/64", read = { { byte = 24, length = 1 } }, format = { number = "%.2f", behind = "%", real = true, width = 0 } },
              },
            },
          },
        },
      },
      [0x127E] = {
        name = "Counters of the EV-DO reverse link",
        {
          head = { section = "Data Rates", least = 1750 },
          fields = {
            { key = "Reverse Link", filter = "data_rates.reverse_link", computation = "data rate", formula = "growth of the weighted sum of the counters since the packet before, divided by 1024 x the growth of the sequence number; empty at the first packet, unchanged where the number has not grown", read = { { byte = 14, length = 4 }, { byte = 18, length = 1720 } }, counters = { { 18, 128 }, { 22, 128 }, { 26, 128 }, { 30, 128 }, { 306, 128 }, { 310, 128 }, { 314, 128 }, { 318, 128 }, { 594, 128 }, { 598, 128 }, { 602, 128 }, { 606, 128 }, { 882, 128 }, { 886, 128 }, { 890, 128 }, { 894, 128 }, { 1170, 128 }, { 1174, 128 }, { 1178, 128 }, { 1182, 128 }, { 1458, 128 }, { 1462, 128 }, { 1466, 128 }, { 1470, 128 }, { 42, 256 }, { 46, 256 }, { 50, 256 }, { 54, 256 }, { 330, 256 }, { 334, 256 }, { 338, 256 }, { 342, 256 }, { 618, 256 }, { 622, 256 }, { 626, 256 }, { 630, 256 }, { 906, 256 }, { 910, 256 }, { 914, 256 }, { 918, 256 }, { 1194, 256 }, { 1198, 256 }, { 1202, 256 }, { 1206, 256 }, { 1482, 256 }, { 1486, 256 }, { 1490, 256 }, { 1494, 256 }, { 66, 512 }, { 70, 512 }, { 74, 512 }, { 78, 512 }, { 354, 512 }, { 358, 512 }, { 362, 512 }, { 366, 512 }, { 642, 512 }, { 646, 512 }, { 650, 512 }, { 654, 512 }, { 930, 512 }, { 934, 512 }, { 938, 512 }, { 942, 512 }, { 1218, 512 }, { 1222, 512 }, { 1226, 512 }, { 1230, 512 }, { 1506, 512 }, { 1510, 512 }, { 1514, 512 }, { 1518, 512 }, { 90, 768 }, { 94, 768 }, { 98, 768 }, { 102, 768 }, { 378, 768 }, { 382, 768 }, { 386, 768 }, { 390, 768 }, { 666, 768 }, { 670, 768 }, { 674, 768 }, { 678, 768 }, { 954, 768 }, { 958, 768 }, { 962, 768 }, { 966, 768 }, { 1242, 768 }, { 1246, 768 }, { 1250, 768 }, { 1254, 768 }, { 1530, 768 }, { 1534, 768 }, { 1538, 768 }, { 1542, 768 }, { 114, 1024 }, { 118, 1024 }, { 122, 1024 }, { 126, 1024 }, { 402, 1024 }, { 406, 1024 }, { 410, 1024 }, { 414, 1024 }, { 690, 1024 }, { 694, 1024 }, { 698, 1024 }, { 702, 1024 }, { 978, 1024 }, { 982, 1024 }, { 986, 1024 }, { 990, 1024 }, { 1266, 1024 }, { 1270, 1024 }, { 1274, 1024 }, { 1278, 1024 }, { 1554, 1024 }, { 1558, 1024 }, { 1562, 1024 }, { 1566, 1024 }, { 138, 1536 }, { 142, 1536 }, { 146, 1536 }, { 150, 1536 }, { 426, 1536 }, { 430, 1536 }, { 434, 1536 }, { 438, 1536 }, { 714, 1536 }, { 718, 1536 }, { 722, 1536 }, { 726, 1536 }, { 1002, 1536 }, { 1006, 1536 }, { 1010, 1536 }, { 1014, 1536 }, { 1290, 1536 }, { 1294, 1536 }, { 1298, 1536 }, { 1302, 1536 }, { 1578, 1536 }, { 1582, 1536 }, { 1586, 1536 }, { 1590, 1536 }, { 162, 2048 }, { 166, 2048 }, { 170, 2048 }, { 174, 2048 }, { 450, 2048 }, { 454, 2048 }, { 458, 2048 }, { 462, 2048 }, { 738, 2048 }, { 742, 2048 }, { 746, 2048 }, { 750, 2048 }, { 1026, 2048 }, { 1030, 2048 }, { 1034, 2048 }, { 1038, 2048 }, { 1314, 2048 }, { 1318, 2048 }, { 1322, 2048 }, { 1326, 2048 }, { 1602, 2048 }, { 1606, 2048 }, { 1610, 2048 }, { 1614, 2048 }, { 186, 3072 }, { 190, 3072 }, { 194, 3072 }, { 198, 3072 }, { 474, 3072 }, { 478, 3072 }, { 482, 3072 }, { 486, 3072 }, { 762, 3072 }, { 766, 3072 }, { 770, 3072 }, { 774, 3072 }, { 1050, 3072 }, { 1054, 3072 }, { 1058, 3072 }, { 1062, 3072 }, { 1338, 3072 }, { 1342, 3072 }, { 1346, 3072 }, { 1350, 3072 }, { 1626, 3072 }, { 1630, 3072 }, { 1634, 3072 }, { 1638, 3072 }, { 210, 4096 }, { 214, 4096 }, { 218, 4096 }, { 222, 4096 }, { 498, 4096 }, { 502, 4096 }, { 506, 4096 }, { 510, 4096 }, { 786, 4096 }, { 790, 4096 }, { 794, 4096 }, { 798, 4096 }, { 1074, 4096 }, { 1078, 4096 }, { 1082, 4096 }, { 1086, 4096 }, { 1362, 4096 }, { 1366, 4096 }, { 1370, 4096 }, { 1374, 4096 }, { 1650, 4096 }, { 1654, 4096 }, { 1658, 4096 }, { 1662, 4096 }, { 234, 6144 }, { 238, 6144 }, { 242, 6144 }, { 246, 6144 }, { 522, 6144 }, { 526, 6144 }, { 530, 6144 }, { 534, 6144 }, { 810, 6144 }, { 814, 6144 }, { 818, 6144 }, { 822, 6144 }, { 1098, 6144 }, { 1102, 6144 }, { 1106, 6144 }, { 1110, 6144 }, { 1386, 6144 }, { 1390, 6144 }, { 1394, 6144 }, { 1398, 6144 }, { 1674, 6144 }, { 1678, 6144 }, { 1682, 6144 }, { 1686, 6144 }, { 258, 8192 }, { 262, 8192 }, { 266, 8192 }, { 270, 8192 }, { 546, 8192 }, { 550, 8192 }, { 554, 8192 }, { 558, 8192 }, { 834, 8192 }, { 838, 8192 }, { 842, 8192 }, { 846, 8192 }, { 1122, 8192 }, { 1126, 8192 }, { 1130, 8192 }, { 1134, 8192 }, { 1410, 8192 }, { 1414, 8192 }, { 1418, 8192 }, { 1422, 8192 }, { 1698, 8192 }, { 1702, 8192 }, { 1706, 8192 }, { 1710, 8192 }, { 282, 12288 }, { 286, 12288 }, { 290, 12288 }, { 294, 12288 }, { 570, 12288 }, { 574, 12288 }, { 578, 12288 }, { 582, 12288 }, { 858, 12288 }, { 862, 12288 }, { 866, 12288 }, { 870, 12288 }, { 1146, 12288 }, { 1150, 12288 }, { 1154, 12288 }, { 1158, 12288 }, { 1434, 12288 }, { 1438, 12288 }, { 1442, 12288 }, { 1446, 12288 }, { 1722, 12288 }, { 1726, 12288 }, { 1730, 12288 }, { 1734, 12288 } }, format = { number = "%.2f", behind = " kbps", real = true, width = 0 } },
          },
        },
      },
      [0x12B6] = {
        name = "Active set of EV-DO",
        {
          head = { section = "EV-DO", least = 25 },
          lists = {
            {
              layout = { key = "Active Set", start = 25, stride = 12, bytes_read = 12, count = { byte = 15, bit = 0, width = 8 }, plus = 0, fit = "all", entry_name = { byte = 0, bit = 0, width = 16 } },
              fields = {
                { key = "", filter = "ev_do.active_set", computation = "energy", formula = "10 x log10(raw / 512)", read = { { byte = 2, length = 2 } }, format = { number = "%+.2f", behind = " dB", real = true, width = 0 } },
              },
            },
          },
        },
      },
      [0x134F] = {
        name = "Identity of the 1x system",
        {
          head = { section = "System Identity", least = 171, condition = { position = { byte = 13, bit = 0, width = 8 }, least = 2, most = 255 } },
          fields = {
            { key = "Roaming Indicator", filter = "system_identity.roaming_indicator", position = { byte = 42, bit = 0, width = 32 }, labels = { [0] = "OFF [0]", [1] = "ON [1]", [2] = "Flashing [2]", [3] = "Out of Neighborhood [3]", [4] = "Out of Building [4]", [5] = "Preferred system [5]", [6] = "Available system [6]", [7] = "Alliance partner [7]", [8] = "Premium partner [8]", [9] = "Full service functionality [9]", [10] = "Partial service functionality [10]", [11] = "Banner ON [11]", [12] = "Banner OFF [12]" }, beyond_format = { number = "%d", before = "ERI - " } },
            { key = "System ID", filter = "system_identity.system_id", position = { byte = 50, bit = 0, width = 16 }, format = { number = "%d" }, condition = { position = { byte = 46, bit = 0, width = 32 }, least = 2, most = 2, otherwise = "(unknown system type %d)" } },
            { key = "Network ID", filter = "system_identity.network_id", position = { byte = 52, bit = 0, width = 16 }, format = { number = "%d" }, condition = { position = { byte = 46, bit = 0, width = 32 }, least = 2, most = 2, otherwise = "(unknown system type %d)" } },
            { key = "Packet Zone ID", filter = "system_identity.packet_zone_id", position = { byte = 131, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "Base Station ID", filter = "system_identity.base_station_id", position = { byte = 184, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Protocol Revision", filter = "system_identity.protocol_revision", position = { byte = 133, bit = 0, width = 8 }, format = { number = "%d" } },
          },
        },
      },
    },
  },
  {
    name = "pallax_lte", title = "LTE", encapsulation = "USER3",
    framing = "record",
    codes = {
      [0xB0C1] = {
        name = "Antennas of the serving cell",
        {
          head = { section = "Serving Cell Info", least = 22 },
          fields = {
            { key = "Num Tx Antennas", filter = "serving_cell_info.num_tx_antennas", position = { byte = 20, bit = 0, width = 8 }, format = { number = "%d" } },
          },
        },
      },
      [0xB0C2] = {
        name = "Identity of the serving cell",
        {
          head = { section = "Serving Cell Info", least = 38 },
          fields = {
            { key = "Physical Cell ID", filter = "serving_cell_info.physical_cell_id", position = { byte = 14, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Download Frequency", filter = "serving_cell_info.download_frequency", position = { byte = 16, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Upload Frequency", filter = "serving_cell_info.upload_frequency", position = { byte = 18, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Download Bandwidth", filter = "serving_cell_info.download_bandwidth", position = { byte = 20, bit = 0, width = 8 }, labels = { [6] = "1.4 MHz", [15] = "3 MHz", [25] = "5 MHz", [50] = "10 MHz", [75] = "15 MHz", [100] = "20 MHz" }, beyond = "Unknown" },
            { key = "Upload Bandwidth", filter = "serving_cell_info.upload_bandwidth", position = { byte = 21, bit = 0, width = 8 }, labels = { [6] = "1.4 MHz", [15] = "3 MHz", [25] = "5 MHz", [50] = "10 MHz", [75] = "15 MHz", [100] = "20 MHz" }, beyond = "Unknown" },
            { key = "Cell Identity", filter = "serving_cell_info.cell_identity", position = { byte = 22, bit = 0, width = 32, signed = true }, format = { number = "%d" } },
            { key = "Tracking Area Code", filter = "serving_cell_info.tracking_area_code", position = { byte = 26, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Freq Band Indicator", filter = "serving_cell_info.freq_band_indicator", position = { byte = 28, bit = 0, width = 32, signed = true }, format = { number = "%d" } },
          },
        },
      },
      [0xB179] = {
        name = "Connected-mode intra-frequency measurement",
        {
          head = { section = "Connected mode LTE Intra-frequency Measurement", least = 29 },
          fields = {
            { key = "E-ARFCN", filter = "connected_mode_lte_intra_frequency_measurement.e_arfcn", position = { byte = 17, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Serving Physical Cell ID", filter = "connected_mode_lte_intra_frequency_measurement.serving_physical_cell_id", position = { byte = 19, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Subframe Number", filter = "connected_mode_lte_intra_frequency_measurement.subframe_number", position = { byte = 21, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Serving Filtered RSRP", filter = "connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrp", position = { byte = 23, bit = 0, width = 16 }, format = { number = "%4.2f", behind = " dBm", real = true, width = 4 }, factor = 0.25, offset = -140 },
            { key = "Serving Filtered RSRQ", filter = "connected_mode_lte_intra_frequency_measurement.serving_filtered_rsrq", position = { byte = 25, bit = 0, width = 16 }, format = { number = "%4.2f", behind = " dB", real = true, width = 4 }, factor = 0.125, offset = -20 },
          },
        },
        {
          head = { section = "Measured Neighbor Cells", least = 29 },
          lists = {
            {
              layout = { key = "", start = 29, stride = 6, bytes_read = 6, count = { byte = 27, bit = 0, width = 8 }, plus = 0, other_count = { byte = 28, bit = 0, width = 8 }, other_length = 2 },
              fields = {
                { key = "Physical Cell ID", filter = "measured_neighbor_cells.physical_cell_id", position = { byte = 0, bit = 0, width = 16 }, format = { number = "%d" } },
                { key = "Filtered RSRP", filter = "measured_neighbor_cells.filtered_rsrp", position = { byte = 2, bit = 0, width = 16 }, format = { number = "%4.2f", behind = " dBm", real = true, width = 4 }, factor = 0.25, offset = -140 },
                { key = "Filtered RSRQ", filter = "measured_neighbor_cells.filtered_rsrq", position = { byte = 4, bit = 0, width = 16 }, format = { number = "%4.2f", behind = " dB", real = true, width = 4 }, factor = 0.125, offset = -20 },
              },
            },
          },
        },
        {
          head = { section = "Detected Cells", least = 29 },
          lists = {
            {
              layout = { key = "", start = 29, stride = 2, bytes_read = 2, move = 6, moved_by = { byte = 27, bit = 0, width = 8 }, count = { byte = 28, bit = 0, width = 8 }, plus = 0 },
              fields = {
                { key = "Physical Cell ID", filter = "detected_cells.physical_cell_id", position = { byte = 0, bit = 0, width = 16 }, format = { number = "%d" } },
              },
            },
          },
        },
      },
      [0xB17F] = {
        name = "Idle-mode measurement of the serving cell",
        {
          head = { section = "Serving Cell Measurements", least = 33 },
          fields = {
            { key = "Version", filter = "serving_cell_measurements.version", position = { byte = 13, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "E-ARFCN", filter = "serving_cell_measurements.e_arfcn", position = { byte = 17, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Physical Cell ID", filter = "serving_cell_measurements.physical_cell_id", position = { byte = 19, bit = 0, width = 9 }, format = { number = "%d" } },
            { key = "Serving Layer Priority", filter = "serving_cell_measurements.serving_layer_priority", position = { byte = 20, bit = 1, width = 4 }, format = { number = "%d" } },
            { key = "Measured RSRP", filter = "serving_cell_measurements.measured_rsrp", position = { byte = 21, bit = 0, width = 9 }, format = { number = "%4.2f", behind = " dBm", real = true, width = 4 }, factor = 0.25, offset = -140 },
            { key = "Average RSRP", filter = "serving_cell_measurements.average_rsrp", position = { byte = 22, bit = 1, width = 9 }, format = { number = "%4.2f", behind = " dBm", real = true, width = 4 }, factor = 0.25, offset = -140 },
            { key = "Measured RSRQ", filter = "serving_cell_measurements.measured_rsrq", position = { byte = 23, bit = 2, width = 7 }, format = { number = "%4.2f", behind = " dB", real = true, width = 4 }, factor = 0.25, offset = -30 },
            { key = "Average RSRQ", filter = "serving_cell_measurements.average_rsrq", position = { byte = 24, bit = 1, width = 7 }, format = { number = "%4.2f", behind = " dB", real = true, width = 4 }, factor = 0.25, offset = -30 },
            { key = "Measured RSSI", filter = "serving_cell_measurements.measured_rssi", position = { byte = 25, bit = 0, width = 9 }, format = { number = "%4.2f", behind = " dBm", real = true, width = 4 }, factor = 0.5, offset = -140 },
            { key = "Qrxlevmin", filter = "serving_cell_measurements.qrxlevmin", position = { byte = 26, bit = 1, width = 6 }, format = { number = "%d", behind = " dBm" }, factor = 2, offset = -140 },
            { key = "P_Max", filter = "serving_cell_measurements.p_max", position = { byte = 26, bit = 7, width = 7 }, format = { number = "%d", behind = " dBm" }, offset = -30, except = 64, except_text = "Not Present" },
            { key = "Max UE Tx Power", filter = "serving_cell_measurements.max_ue_tx_power", position = { byte = 27, bit = 6, width = 6 }, format = { number = "%d", behind = " dBm" }, offset = -30, except = 64, except_text = "Not Present" },
            { key = "Srxlev", filter = "serving_cell_measurements.srxlev", position = { byte = 29, bit = 0, width = 7 }, format = { number = "%d", behind = " dBm" }, offset = -30 },
            { key = "Num of Consecutive DRX Cycles of S < 0", filter = "serving_cell_measurements.num_of_consecutive_drx_cycles_of_s_0", position = { byte = 29, bit = 7, width = 6 }, format = { number = "%d" } },
            { key = "S Intra Search", filter = "serving_cell_measurements.s_intra_search", position = { byte = 30, bit = 5, width = 6 }, format = { number = "%d", behind = " dB" }, factor = 2, except = 32, except_text = "Not Present" },
            { key = "S Non Intra Search", filter = "serving_cell_measurements.s_non_intra_search", position = { byte = 31, bit = 3, width = 6 }, format = { number = "%d", behind = " dBm" }, factor = 2, except = 32, except_text = "Not Present" },
            { key = "Measurement Rules Updated", filter = "serving_cell_measurements.measurement_rules_updated", position = { byte = 32, bit = 1, width = 1 }, labels = {  }, beyond = "True", except = 0, except_text = "False" },
            { key = "Measurement Rules", filter = "serving_cell_measurements.measurement_rules", position = { byte = 32, bit = 2, width = 4 }, format = { number = "%d" } },
          },
        },
      },
      [0xB180] = {
        name = "Idle-mode measurement of the neighbours",
        {
          head = { section = "Neighbor Measurements", least = 21 },
          fields = {
            { key = "Version", filter = "neighbor_measurements.version", position = { byte = 13, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "E-ARFCN", filter = "neighbor_measurements.e_arfcn", position = { byte = 17, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Qrxlevmin", filter = "neighbor_measurements.qrxlevmin", position = { byte = 19, bit = 0, width = 6 }, format = { number = "%d", behind = " dBm" }, factor = 2, offset = -140 },
          },
        },
        {
          head = { section = "Neighbor Cells List", least = 21 },
          lists = {
            {
              layout = { key = "", start = 21, stride = 20, bytes_read = 16, count = { byte = 19, bit = 6, width = 5 }, plus = 1 },
              fields = {
                { key = "Physical Cell ID", filter = "neighbor_cells_list.physical_cell_id", position = { byte = 0, bit = 0, width = 9 }, format = { number = "%d" } },
                { key = "Measured RSSI", filter = "neighbor_cells_list.measured_rssi", position = { byte = 1, bit = 1, width = 8 }, format = { number = "%4.2f", behind = " dBm", real = true, width = 4 }, factor = 0.5, offset = -140 },
                { key = "Measured RSRP", filter = "neighbor_cells_list.measured_rsrp", position = { byte = 2, bit = 1, width = 9 }, format = { number = "%4.2f", behind = " dBm", real = true, width = 4 }, factor = 0.5, offset = -140 },
                { key = "Average RSRP", filter = "neighbor_cells_list.average_rsrp", position = { byte = 4, bit = 0, width = 9 }, format = { number = "%4.2f", behind = " dBm", real = true, width = 4 }, factor = 0.5, offset = -140 },
                { key = "Measured RSRQ", filter = "neighbor_cells_list.measured_rsrq", position = { byte = 5, bit = 1, width = 7 }, format = { number = "%4.2f", behind = " dB", real = true, width = 4 }, factor = 0.25, offset = -30 },
                { key = "Average RSRQ", filter = "neighbor_cells_list.average_rsrq", position = { byte = 6, bit = 0, width = 7 }, format = { number = "%4.2f", behind = " dB", real = true, width = 4 }, factor = 0.25, offset = -30 },
                { key = "Srxlev", filter = "neighbor_cells_list.srxlev", position = { byte = 6, bit = 7, width = 7 }, format = { number = "%d", behind = " dBm" }, offset = -30 },
                { key = "Frequency Offset", filter = "neighbor_cells_list.frequency_offset", position = { byte = 8, bit = 0, width = 16 }, format = { number = "%d" } },
                { key = "Ant 0 Frame Offset", filter = "neighbor_cells_list.ant_0_frame_offset", position = { byte = 12, bit = 0, width = 11 }, format = { number = "%d" } },
                { key = "Ant 0 Sample Offset", filter = "neighbor_cells_list.ant_0_sample_offset", position = { byte = 13, bit = 3, width = 19 }, format = { number = "%d" } },
                { key = "Ant 1 Frame Offset", filter = "neighbor_cells_list.ant_1_frame_offset", position = { byte = 12, bit = 0, width = 11 }, format = { number = "%d" } },
                { key = "Ant 1 Sample Offset", filter = "neighbor_cells_list.ant_1_sample_offset", position = { byte = 13, bit = 3, width = 19 }, format = { number = "%d" } },
              },
            },
          },
        },
      },
      [0xB186] = {
        name = "Candidates of the idle-mode reselection",
        {
          head = { section = "Reselection Candidates", least = 21 },
          fields = {
            { key = "Version", filter = "reselection_candidates.version", position = { byte = 13, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "Serving EARFCN", filter = "reselection_candidates.serving_earfcn", position = { byte = 15, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Serving Cell ID", filter = "reselection_candidates.serving_cell_id", position = { byte = 17, bit = 0, width = 16 }, format = { number = "%d" } },
          },
        },
        {
          head = { section = "Reselection Candidates List", least = 21 },
          lists = {
            {
              layout = { key = "", start = 21, stride = 4, bytes_read = 4, count = { byte = 19, bit = 0, width = 16 }, plus = 0 },
              fields = {
                { key = "Candidate Priority", filter = "reselection_candidates_list.candidate_priority", position = { byte = 0, bit = 0, width = 16 }, format = { number = "%d" } },
                { key = "Candidate RAT Type", filter = "reselection_candidates_list.candidate_rat_type", position = { byte = 2, bit = 0, width = 16 }, labels = { [0] = "LTE", [1] = "UTRAN", [2] = "GERAN", [3] = "CDMA1XRTT", [4] = "CDMAHRPD" }, beyond = "??" },
                { key = "E ARFCN", filter = "reselection_candidates_list.e_arfcn", position = { byte = 4, bit = 0, width = 16 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 0, most = 0 } },
                { key = "Cell ID", filter = "reselection_candidates_list.cell_id", position = { byte = 6, bit = 7, width = 9 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 0, most = 0 } },
                { key = "U ARFCN", filter = "reselection_candidates_list.u_arfcn", position = { byte = 4, bit = 0, width = 16 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 1, most = 1 } },
                { key = "PSC", filter = "reselection_candidates_list.psc", position = { byte = 6, bit = 0, width = 16 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 1, most = 1 } },
                { key = "ARFCN", filter = "reselection_candidates_list.arfcn", position = { byte = 4, bit = 0, width = 16 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 2, most = 2 } },
                { key = "Band", filter = "reselection_candidates_list.band", position = { byte = 6, bit = 0, width = 8 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 2, most = 2 } },
                { key = "BSIC ID", filter = "reselection_candidates_list.bsic_id", position = { byte = 7, bit = 0, width = 8 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 2, most = 2 } },
                { key = "Band", filter = "reselection_candidates_list.band", position = { byte = 4, bit = 0, width = 8 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 3, most = 3 } },
                { key = "Channel", filter = "reselection_candidates_list.channel", position = { byte = 8, bit = 0, width = 16 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 3, most = 3 } },
                { key = "Pilot", filter = "reselection_candidates_list.pilot", position = { byte = 10, bit = 0, width = 16 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 3, most = 3 } },
                { key = "Band", filter = "reselection_candidates_list.band", position = { byte = 4, bit = 0, width = 8 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 4, most = 4 } },
                { key = "Channel", filter = "reselection_candidates_list.channel", position = { byte = 8, bit = 0, width = 16 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 4, most = 4 } },
                { key = "Pilot", filter = "reselection_candidates_list.pilot", position = { byte = 10, bit = 0, width = 16 }, format = { number = "%d" }, condition = { position = { byte = 2, bit = 0, width = 16 }, least = 4, most = 4 } },
              },
            },
          },
        },
      },
      [0xFF0000] = {
        name = "SIM files",
        {
          head = { section = "SIM Info", least = 0 },
          list = { part = "keys" },
          fields = {
            { key = "EF-ICCID", filter = "sim_info.ef_iccid", list_key = "kSimFile_ICCID" },
            { key = "EF-MSISDN", filter = "sim_info.ef_msisdn", list_key = "kSimFile_MSISDN" },
            { key = "EF-3GPP MAIL BOX DIALING NUMBER", filter = "sim_info.ef_3gpp_mail_box_dialing_number", list_key = "kSimFile_MBDN" },
            { key = "EF-HPPLMN SEARCH PERIOD", filter = "sim_info.ef_hpplmn_search_period", list_key = "kSimFile_HPPLMN" },
            { key = "EF-LOCI", filter = "sim_info.ef_loci", list_key = "kSimFile_LOCI" },
            { key = "EF-GPRS/PS-LOCI", filter = "sim_info.ef_gprs_ps_loci", list_key = "kSimFile_PSLOCI" },
            { key = "EF-ACCESS CONTROL CLASS", filter = "sim_info.ef_access_control_class", list_key = "kSimFile_ACC" },
            { key = "EF-ADMINISTRATIVE DATA", filter = "sim_info.ef_administrative_data", list_key = "kSimFile_AD" },
            { key = "EF-FPLMN", filter = "sim_info.ef_fplmn", list_key = "kSimFile_FPLMN" },
            { key = "EF-ACTING HPLMN", filter = "sim_info.ef_acting_hplmn", list_key = "kSimFile_AHPLMN" },
            { key = "EF-RAT MODE", filter = "sim_info.ef_rat_mode", list_key = "kSimFile_RATMODE" },
            { key = "EF-PLMN NETWORK NAME", filter = "sim_info.ef_plmn_network_name", list_key = "kSimFile_PNN" },
            { key = "EF-OPERATOR PLMN LIST", filter = "sim_info.ef_operator_plmn_list", list_key = "kSimFile_OPL" },
            { key = "EF-OPLMNAcT", filter = "sim_info.ef_oplmnact", list_key = "kSimFile_OPLMNAcT" },
          },
        },
      },
      [0xFF0001] = {
        name = "Cell monitor",
        {
          head = { section = "Serving Cell Info", least = 0 },
          list = { part = "first cell", technologies = { "kHXCellMonitorRadioAccessTechnologyLTE" }, cell_type = "kHXCellMonitorCellTypeServing" },
          fields = {
            { key = "Tracking Area Code", filter = "serving_cell_info.tracking_area_code", list_key = "kHXCellMonitorTAC", format = { number = "%d" } },
            { key = "Cell Identity", filter = "serving_cell_info.cell_identity", list_key = "kHXCellMonitorCellId", format = { number = "%d" } },
            { key = "Physical Cell ID", filter = "serving_cell_info.physical_cell_id", list_key = "kHXCellMonitorPID", format = { number = "%d" } },
            { key = "Freq Band Indicator", filter = "serving_cell_info.freq_band_indicator", list_key = "kHXCellMonitorBandInfo", format = { number = "%d" } },
            { key = "UARFCN", filter = "serving_cell_info.uarfcn", list_key = "kHXCellMonitorUARFCN", format = { number = "%d" } },
          },
        },
      },
      [0xFF0002] = {
        name = "Contexts of packet data",
        {
          head = { section = "PDP Context Info", least = 0 },
          list = { part = "elements" },
        },
      },
    },
  },
  {
    name = "pallax_utran", title = "UTRAN", encapsulation = "USER4",
    framing = "record",
    codes = {
      [0xD00A] = {
        name = "Measurement of the UTRAN neighbours",
        {
          head = { section = "Neighbor Cell List", least = 21 },
          lists = {
            {
              layout = { key = "", start = 168, stride = 16, bytes_read = 4, count = { byte = 16, bit = 1, width = 7 }, plus = 0 },
              fields = {
                { key = "UARFCN", filter = "neighbor_cell_list.uarfcn", position = { byte = 0, bit = 0, width = 14 }, format = { number = "%d" } },
                { key = "Cell ID", filter = "neighbor_cell_list.cell_id", position = { byte = 1, bit = 6, width = 7 }, format = { number = "%d" } },
                { key = "Filter RSCP", filter = "neighbor_cell_list.filter_rscp", position = { byte = 2, bit = 5, width = 8 }, format = { number = "%f", real = true, width = 0 }, factor = 0.00390625 },
                { key = "Status", filter = "neighbor_cell_list.status", position = { byte = 3, bit = 5, width = 2 }, labels = { [0] = "ASET", [1] = "MSET", [2] = "DSET" }, beyond = "Unknown", condition = { position = { byte = 3, bit = 5, width = 2 }, least = 0, most = 2 } },
                { key = "inJDCS", filter = "neighbor_cell_list.injdcs", position = { byte = 3, bit = 7, width = 1 }, labels = {  }, beyond = "TRUE", except = 0, except_text = "FALSE" },
              },
            },
          },
        },
      },
      [0xD00C] = {
        name = "Quality of the transport channels",
        {
          head = { section = "TRCH BLER", least = 17 },
          lists = {
            {
              layout = { key = "", start = 17, stride = 2, bytes_read = 2, count = { byte = 14, bit = 6, width = 6 }, plus = 0 },
              fields = {
                { key = "TRCH ID", filter = "trch_bler.trch_id", position = { byte = 0, bit = 0, width = 8 }, format = { number = "%d" } },
                { key = "TRCH BLER Measurement", filter = "trch_bler.trch_bler_measurement", position = { byte = 1, bit = 0, width = 8 }, format = { number = "%d" } },
              },
            },
          },
        },
        {
          head = { section = "CCTRCH SIR", least = 17 },
          lists = {
            {
              layout = { key = "", start = 289, stride = 8, bytes_read = 8, move = 34, moved_by = { byte = 14, bit = 6, width = 6 }, count = { byte = 15, bit = 4, width = 4 }, plus = 0 },
              fields = {
                { key = "CCTRCH ID", filter = "cctrch_sir.cctrch_id", position = { byte = 0, bit = 0, width = 8 }, format = { number = "%d" } },
                { key = "TSNUM", filter = "cctrch_sir.tsnum", position = { byte = 1, bit = 0, width = 8 }, format = { number = "%d" } },
              },
              lists = {
                {
                  layout = { key = "SIR", start = 2, stride = 1, bytes_read = 1, plus = 6 },
                  fields = {
                    { key = "", filter = "cctrch_sir.sir", position = { byte = 0, bit = 0, width = 8 }, format = { number = "%d" } },
                  },
                },
              },
            },
          },
        },
      },
      [0xD00E] = {
        name = "Measurement of the GSM neighbours",
        {
          head = { section = "GSM Neighbor Cell List", least = 17 },
          lists = {
            {
              layout = { key = "", start = 17, stride = 8, bytes_read = 8, count = { byte = 16, bit = 0, width = 8 }, plus = 0, hidden = true },
              fields = {
                { key = "Cell ID", filter = "gsm_neighbor_cell_list.cell_id", position = { byte = 0, bit = 0, width = 14 }, format = { number = "%d" } },
                { key = "Band Indicator", filter = "gsm_neighbor_cell_list.band_indicator", position = { byte = 1, bit = 6, width = 1 }, format = { number = "%d" } },
                { key = "BSIC Valid", filter = "gsm_neighbor_cell_list.bsic_valid", position = { byte = 1, bit = 7, width = 1 }, format = { number = "%d" } },
                { key = "NCC", filter = "gsm_neighbor_cell_list.ncc", position = { byte = 2, bit = 0, width = 8 }, format = { number = "%d" } },
                { key = "BCC", filter = "gsm_neighbor_cell_list.bcc", position = { byte = 3, bit = 0, width = 8 }, format = { number = "%d" } },
                { key = "ARFCN", filter = "gsm_neighbor_cell_list.arfcn", position = { byte = 4, bit = 0, width = 16 }, format = { number = "%d" } },
                { key = "RSSI", filter = "gsm_neighbor_cell_list.rssi", position = { byte = 6, bit = 0, width = 16, signed = true }, format = { number = "%d" } },
              },
            },
          },
        },
      },
      [0xD0E0] = {
        name = "State of the RRC connection",
        {
          head = { section = "RRC Info", least = 13 },
          fields = {
            { key = "State", filter = "rrc_info.state", position = { byte = 14, bit = 0, width = 8 }, labels = { [0] = "Disconnected", [1] = "Connecting", [2] = "Cell Fach", [3] = "Cell DCH", [4] = "Cell PCH", [5] = "Cell URA PCH" }, beyond = "Unknown RRC Mode", condition = { position = { byte = 13, bit = 0, width = 8 }, least = 1, most = 1, otherwise = "Unknown RRC Mode" } },
          },
        },
      },
      [0xD0E2] = {
        name = "Serving cell",
        {
          head = { section = "Serving Cell Info", least = 26 },
          fields = {
            { key = "Cell Access Restrictions", filter = "serving_cell_info.cell_access_restrictions", position = { byte = 14, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "Cell ID", filter = "serving_cell_info.cell_id", position = { byte = 21, bit = 0, width = 32, signed = true }, format = { number = "%d" } },
            { key = "Downlink UARFCN", filter = "serving_cell_info.downlink_uarfcn", position = { byte = 19, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "Uplink UARFCN", filter = "serving_cell_info.uplink_uarfcn", position = { byte = 17, bit = 0, width = 16 }, format = { number = "%d" } },
            { key = "URA ID", filter = "serving_cell_info.ura_id", position = { byte = 15, bit = 0, width = 8 }, format = { number = "%d" } },
            { key = "Allowed Access", filter = "serving_cell_info.allowed_access", position = { byte = 25, bit = 0, width = 1 }, labels = {  }, beyond = "Emergency Calls Only", except = 0, except_text = "All Calls" },
          },
        },
      },
      [0xFF0000] = {
        name = "SIM files",
        {
          head = { section = "SIM Info", least = 0 },
          list = { part = "keys" },
          fields = {
            { key = "EF-ICCID", filter = "sim_info.ef_iccid", list_key = "kSimFile_ICCID" },
            { key = "EF-MSISDN", filter = "sim_info.ef_msisdn", list_key = "kSimFile_MSISDN" },
            { key = "EF-3GPP MAIL BOX DIALING NUMBER", filter = "sim_info.ef_3gpp_mail_box_dialing_number", list_key = "kSimFile_MBDN" },
            { key = "EF-HPPLMN SEARCH PERIOD", filter = "sim_info.ef_hpplmn_search_period", list_key = "kSimFile_HPPLMN" },
            { key = "EF-LOCI", filter = "sim_info.ef_loci", list_key = "kSimFile_LOCI" },
            { key = "EF-GPRS/PS-LOCI", filter = "sim_info.ef_gprs_ps_loci", list_key = "kSimFile_PSLOCI" },
            { key = "EF-ACCESS CONTROL CLASS", filter = "sim_info.ef_access_control_class", list_key = "kSimFile_ACC" },
            { key = "EF-ADMINISTRATIVE DATA", filter = "sim_info.ef_administrative_data", list_key = "kSimFile_AD" },
            { key = "EF-FPLMN", filter = "sim_info.ef_fplmn", list_key = "kSimFile_FPLMN" },
            { key = "EF-ACTING HPLMN", filter = "sim_info.ef_acting_hplmn", list_key = "kSimFile_AHPLMN" },
            { key = "EF-RAT MODE", filter = "sim_info.ef_rat_mode", list_key = "kSimFile_RATMODE" },
            { key = "EF-PLMN NETWORK NAME", filter = "sim_info.ef_plmn_network_name", list_key = "kSimFile_PNN" },
            { key = "EF-OPERATOR PLMN LIST", filter = "sim_info.ef_operator_plmn_list", list_key = "kSimFile_OPL" },
            { key = "EF-OPLMNAcT", filter = "sim_info.ef_oplmnact", list_key = "kSimFile_OPLMNAcT" },
          },
        },
      },
      [0xFF0001] = {
        name = "Cell monitor",
        {
          head = { section = "Serving Cell Info", least = 0 },
          list = { part = "each cell", technologies = { "kHXCellMonitorRadioAccessTechnologyUTRAN2" }, cell_type = "kHXCellMonitorCellTypeServing" },
          fields = {
            { key = "Local Area Code", filter = "serving_cell_info.local_area_code", list_key = "kHXCellMonitorLAC", format = { number = "%d" } },
            { key = "Cell ID", filter = "serving_cell_info.cell_id", list_key = "kHXCellMonitorCellId", format = { number = "%d" } },
            { key = "Freq Band Indicator", filter = "serving_cell_info.freq_band_indicator", list_key = "kHXCellMonitorBandInfo", format = { number = "%d" } },
            { key = "Cell Scrambling Code", filter = "serving_cell_info.cell_scrambling_code", list_key = "kHXCellMonitorSCN", format = { number = "%d" } },
            { key = "Uplink UARFCN", filter = "serving_cell_info.uplink_uarfcn", list_key = "kHXCellMonitorUARFCN", format = { number = "%d" } },
            { key = "Downlink UARFCN", filter = "serving_cell_info.downlink_uarfcn", list_key = "kHXCellMonitorUARFCN", format = { number = "%d" } },
          },
        },
      },
      [0xFF0002] = {
        name = "Contexts of packet data",
        {
          head = { section = "PDP Context Info", least = 0 },
          list = { part = "elements" },
        },
      },
    },
  },
}

local energy_bands = {
  { 706, -31 },
  { 814, -30 },
  { 950, -29 },
  { 1121, -28 },
  { 1337, -27 },
  { 1608, -26 },
  { 1950, -25 },
  { 2241, -24 },
  { 2922, -23 },
  { 3604, -22 },
  { 4462, -21 },
  { 5543, -20 },
  { 6903, -19 },
  { 8616, -18 },
  { 10772, -17 },
  { 13487, -16 },
  { 16904, -15 },
  { 21206, -14 },
  { 26622, -13 },
  { 33441, -12 },
  { 42024, -11 },
  { 52831, -10 },
  { 66436, -9 },
  { 83563, -8 },
  { 105124, -7 },
  { 132269, -6 },
  { 166442, -5 },
  { 209464, -4 },
  { 263625, -3 },
  { 331809, -2 },
  { 417648, -1 },
  { 524288, 0 },
}

-- From here on: the code that interprets the tables.
--
-- Every loop ends with the log record's bytes, and bytes past its end read as zero. Values that depend
-- on earlier packets are computed when the packets are first read in order, and stored by packet.

local HEADER_LENGTH = 13
local STANDARD_TYPE, EXTENDED_TYPE = 1, 255
local EXTENDED_CODES = 0xFF0000
local PREFIX, PREFIX_LENGTH = 0x81, 2
local SUBPACKET_COUNT, FIRST_SUBPACKET = 14, 17
local TRAFFIC = 8 -- the 1x device state

-- Numbers

local function byte_at(record, at)
  return at < record:len() and record(at, 1):uint() or 0
end

local function byte_count(position)
  return math.floor((position.bit + position.width + 7) / 8)
end

-- The number at a position relative to `start`.
local function number_at(record, start, position)
  local count, value = byte_count(position), 0
  for index = 0, count - 1 do
    local place = position.big and count - 1 - index or index
    value = value + byte_at(record, start + position.byte + index) * 256 ^ place
  end
  value = math.floor(value / 2 ^ position.bit) % 2 ^ position.width
  if position.signed and value >= 2 ^ (position.width - 1) then
    value = value - 2 ^ position.width
  end
  return value
end

local function whole_bytes(at, count)
  return { byte = at, bit = 0, width = 8 * count }
end

-- The available bytes from `at` on.
local function range_of(record, at, length)
  local first = math.min(at, record:len())
  return record:range(first, math.min(length, record:len() - first))
end

local function toward_zero(value)
  return value >= 0 and math.floor(value) or math.ceil(value)
end

-- Converts to a signed number with this many bits.
local function signed(value, bits)
  value = value % 2 ^ bits
  return value >= 2 ^ (bits - 1) and value - 2 ^ bits or value
end

-- Rounds to single precision.
local function single(value)
  if value == 0 then return 0 end
  local unit = 2 ^ (math.floor(math.log(math.abs(value)) / math.log(2)) - 23)
  local steps = value / unit
  local below = math.floor(steps)
  local rest = steps - below
  if rest > 0.5 or (rest == 0.5 and below % 2 == 1) then below = below + 1 end
  return below * unit
end

local function decibels(ratio)
  return 10 * math.log(ratio, 10)
end

-- Texts

local function formatted(format, value)
  local number
  if format.real then
    if value ~= value then
      number = string.rep(" ", format.width - 3) .. "nan"
    else
      number = string.format(format.number, value)
    end
  else
    local whole = toward_zero(value)
    number = string.format(format.number, format.unsigned and whole % 2 ^ 32 or signed(whole, 32))
  end
  return (format.before or "") .. number .. (format.behind or "")
end

-- The text of a raw number and, if it is numeric, its value.
local function text_of(field, raw)
  if field.except == raw then return field.except_text end
  if field.format then
    local value = raw * (field.factor or 1) + (field.offset or 0)
    return formatted(field.format, value), value
  end
  local index = field.shift and (raw + field.shift) % 256 or raw
  if field.labels[index] then return field.labels[index] end
  return field.beyond_format and formatted(field.beyond_format, raw) or field.beyond
end

-- State from earlier packets

local function once(context, name, compute)
  local remembered = context.technology.remembered
  local key = context.pinfo.number .. " " .. name
  if not context.pinfo.visited and remembered[key] == nil then
    remembered[key] = compute() or false
  end
  return remembered[key] or nil
end

-- Computed values: each function takes the numbers of the bytes that it reads, and returns a number or
-- a text, or nothing if nothing is shown.

local function digit(half)
  return half <= 9 and tostring(math.floor(half)) or " "
end

local function low_digit(byte)
  return digit(byte % 16)
end

local function high_digit(byte)
  return digit(math.floor(byte / 16))
end

local function ecno(first, second, third)
  local energy = first ~= 0 and first or second ~= 0 and second or third
  local level = 0
  for _, band in ipairs(energy_bands) do
    if energy < band[1] then break end
    level = band[2]
  end
  return level
end

local computations = {}

computations["country code"] = function(v)
  return low_digit(v[1]) .. high_digit(v[1]) .. low_digit(v[2])
end

computations["network code"] = function(v)
  return low_digit(v[1]) .. high_digit(v[1]) .. high_digit(v[2])
end

computations["digits"] = function(v)
  return 100 * v[1] + 10 * v[2] + v[3]
end

computations["ecno"] = function(v)
  return ecno(v[1], v[2], v[3])
end

computations["rscp"] = function(v)
  return toward_zero((signed(v[4], 16) + 512) / 10) - 106 + ecno(v[1], v[2], v[3])
end

computations["energy"] = function(v)
  return decibels(v[1] / 512)
end

computations["mean power"] = function(_, _, context)
  local list = context.part.lists[1]
  local layout, field = list.layout, list.fields[1]
  local sum, counted = 0, 0
  for index = 0, number_at(context.record, 0, layout.count) - 1 do
    local start = layout.start + index * layout.stride
    if start + layout.bytes_read > context.record:len() then break end
    local raw = number_at(context.record, start, field.position)
    if raw ~= 0 then
      sum = sum + toward_zero((raw + 512) / 10) - 70
      counted = counted + 1
    end
  end
  return sum / counted
end

computations["bsic"] = function(v, _, context)
  return once(context, "bsic " .. v[1], function()
    local told = context.technology.memory.bsic
    return told and told[v[1]]
  end)
end

computations["data rate"] = function(v, field, context)
  return once(context, field.filter, function()
    local memory, sum = context.technology.memory, 0
    for _, counter in ipairs(field.counters) do
      sum = sum + number_at(context.record, 0, whole_bytes(counter[1], 4)) * counter[2]
    end
    local before = memory[field.filter]
    memory[field.filter] = { sequence = v[1], sum = sum }
    if not before then return "" end
    local steps = signed(v[1] - before.sequence, 32)
    return steps >= 1 and (sum - before.sum) / (steps * 1024) or nil
  end)
end

computations["frame errors"] = function(v, _, context)
  return once(context, "frame errors", function()
    local memory = context.technology.memory
    local rate = v[1] ~= 0 and 1 / 64 or 0
    if memory.frame_errors then
      rate = single(rate + single(memory.frame_errors * 63 / 64))
    end
    memory.frame_errors = rate
    return single(rate * 100)
  end)
end

computations["old frame errors"] = function(v, _, context)
  return once(context, "old frame errors", function()
    local memory = context.technology.memory
    if v[1] == TRAFFIC or not memory.frame_errors then return nil end
    local rate = memory.frame_errors
    memory.frame_errors = nil
    return single(rate * 100)
  end)
end

-- The origin of an extent's byte offsets.
local function origin_of(context, extent)
  if extent.of == "record" then return 0 end
  return extent.of == "companion" and context.companion or context.start
end

local function values_of(context, field)
  local values = {}
  for index, extent in ipairs(field.read) do
    local start = origin_of(context, extent)
    if extent.length <= 4 then
      local position = whole_bytes(extent.byte, extent.length)
      values[index] = number_at(context.record, start, position)
    end
  end
  return values
end

-- Items

-- An item with its label and, under `filter`, its filter field if that is known.
local function add_labelled(context, tree, filter, range, text, value, label)
  local known = filter and context.technology.fields[filter]
  if known and known.is_number and value and value == value then
    tree:add(known.field, range, value, label)
  elseif known and not known.is_number then
    tree:add(known.field, range, text, label)
  else
    tree:add(range, label) -- also for a text if other values of the key are numbers
  end
end

local function add_item(context, tree, field, range, text, value)
  local label = field.key ~= "" and field.key .. ": " .. text or text
  add_labelled(context, tree, field.filter, range, text, value, label)
end

local function number_of(context, condition)
  local start = condition.subpacket and context.subpackets[condition.subpacket] or context.start
  return number_at(context.record, start, condition.position)
end

local function holds(context, condition)
  local number = number_of(context, condition)
  return number >= condition.least and number <= condition.most
end

-- The bytes of a field; for a computed field, from the first to the last byte read in the same place as
-- its first extent.
local function range_of_field(context, field)
  if field.position then
    local position = field.position
    return range_of(context.record, context.start + position.byte, byte_count(position))
  end
  local of, first, last = field.read[1].of, math.huge, 0
  for _, extent in ipairs(field.read) do
    if extent.of == of then
      first = math.min(first, extent.byte)
      last = math.max(last, extent.byte + extent.length)
    end
  end
  local start = origin_of(context, field.read[1])
  return range_of(context.record, start + first, last - first)
end

-- The text of a field, and its number if it has one; nothing if it is not shown.
local function value_of(context, field)
  if field.condition and not holds(context, field.condition) then
    local otherwise = field.condition.otherwise
    if not otherwise or not otherwise:find("%%d") then return otherwise end
    return string.format(otherwise, signed(number_of(context, field.condition), 32))
  end
  if not field.computation then
    return text_of(field, number_at(context.record, context.start, field.position))
  end
  local value = computations[field.computation](values_of(context, field), field, context)
  if type(value) == "number" then return formatted(field.format, value), value end
  return value
end

local function add_field(context, tree, field)
  local text, value = value_of(context, field)
  if text then
    add_item(context, tree, field, range_of_field(context, field), text, value)
  end
end

-- Lists

local add_parts -- defined below: an entry may contain lists

local function run_start(context, run)
  local moved = run.move and run.move * number_at(context.record, context.start, run.moved_by) or 0
  return context.start + run.start + moved
end

local function entry_count(context, layout)
  local count = layout.count and number_at(context.record, context.start, layout.count) or 0
  return count + layout.plus
end

-- Whether a log record of this length shows the list at all.
local function fits(context, layout, count)
  local length = context.record:len()
  local last = run_start(context, layout) + count * layout.stride
  if layout.fit == "exact" and last ~= length or layout.fit == "all" and last > length then
    return false
  end
  if not layout.other_count then return true end
  local other = layout.other_length * number_at(context.record, context.start, layout.other_count)
  return count ~= 0 and (count * layout.stride) % 256 <= (length - other) % 256
end

-- Whether all displayed parts of an entry are inside the log record.
local function is_whole(entry, layout, fields)
  local length = entry.record:len()
  if entry.start + layout.bytes_read > length then return false end
  for _, field in ipairs(fields or {}) do
    local position = field.position
    local is_shown = not field.condition or holds(entry, field.condition)
    if position and is_shown and entry.start + position.byte + byte_count(position) > length then
      return false
    end
  end
  return true
end

local function inside(context, start)
  return setmetatable({ start = start }, { __index = context })
end

-- Calls `see` with each displayed entry and its index.
local function each_entry(context, list, count, see)
  local layout, length = list.layout, context.record:len()
  local start = run_start(context, layout)
  local companions = layout.companion and run_start(context, layout.companion)
  for index = 0, count - 1 do
    local entry = inside(context, start + index * layout.stride)
    if not is_whole(entry, layout, list.fields) then return end
    if not layout.only or holds(entry, layout.only) then
      if companions then
        entry.companion = companions + index * layout.companion.stride
        if entry.companion + layout.companion.bytes_read > length then return end
      end
      see(entry, index)
    end
  end
end

local function remember(context, list, count)
  if not context.pinfo.visited then
    local told = {}
    each_entry(context, list, count, function(entry)
      local key = number_at(entry.record, entry.start, list.fields[1].position)
      told[key] = number_at(entry.record, entry.start, list.fields[2].position)
    end)
    context.technology.memory[list.layout.remembered_as] = told
  end
end

local function add_entry(context, tree, list, entry, index)
  local layout, field = list.layout, list.fields[1]
  if layout.entry_name then
    local name = string.format("%d;%d", index, number_at(entry.record, entry.start, layout.entry_name))
    local text, value = value_of(entry, field)
    add_item(entry, tree, { key = name, filter = field.filter }, range_of_field(entry, field), text, value)
  elseif field.key == "" then
    add_field(entry, tree, field)
  else
    local range = range_of(context.record, entry.start, layout.stride)
    add_parts(entry, tree:add(range, "Entry " .. index), list)
  end
end

-- The pilots of the 1x active set; the subpacket gives their number and scale.
local function add_varying(context, tree, list)
  local least = 0.00001
  local layout, field = list.layout, list.fields[1]
  local v = values_of(context, field)
  local divisor, gain, exponent, size, reference = v[1], v[2], v[3], v[4], v[5]
  local stride, energy_at = math.floor((6 * size + 15) / 4) * 4, 4 * size + 24
  for index = 0, entry_count(context, layout) - 1 do
    local start = context.start + index * stride
    if start + energy_at + 2 > context.record:len() then return end
    local pn = number_at(context.record, start, layout.entry_name)
    local energy = number_at(context.record, start, whole_bytes(energy_at, 2))
    local scaled = energy * 2 ^ (2 * exponent - 3)
    local ratio = scaled / (9 * divisor * divisor * gain) - 1 / divisor
    local level = decibels(ratio > least and ratio or least)
    local text = (pn == reference and "(ref pilot) " or "") .. formatted(field.format, level)
    local item = { key = string.format("%d;%d", index, pn), filter = field.filter }
    add_item(context, tree, item, range_of(context.record, start + energy_at, 2), text, level)
  end
end

local function add_list(context, tree, list)
  local layout = list.layout
  if layout.varying then
    return add_varying(context, tree:add(range_of(context.record, context.start, 1), layout.key), list)
  end
  local count = entry_count(context, layout)
  if not fits(context, layout, count) or layout.stays_without_entries and count == 0 then return end
  if layout.remembered_as then remember(context, list, count) end
  local range = range_of(context.record, run_start(context, layout), count * layout.stride)
  if layout.hidden then
    tree = tree:add(range, "Not displayed")
  elseif layout.key ~= "" then
    tree = tree:add(range, layout.key)
  end
  local shown = 0
  each_entry(context, list, count, function(entry, index)
    shown = shown + 1
    add_entry(context, tree, list, entry, index)
  end)
  if shown == 0 and layout.entry_name then tree:append_text(": (none)") end
end

function add_parts(context, tree, part)
  for _, field in ipairs(part.fields or {}) do add_field(context, tree, field) end
  for _, list in ipairs(part.lists or {}) do add_list(context, tree, list) end
end

-- Property lists: the bytes of a serialized object as a tree of nodes.
--
-- A node has its kind ("string", "integer", "real", "boolean", "data", "date", "array" or
-- "dictionary") and its byte range; a scalar has its text, a number also its value. Inputs that Pallax
-- refuses are refused here too. The limits of depth and size are lower than in Pallax, and unusual XML
-- is not read.

local DEEPEST_LIST, MOST_VALUES = 64, 20000
local MOST_EXPANDED = 65536 -- bytes of texts, in addition to those of the list
local SECONDS_OF_DAY = 86400
local REFUSAL = "no property list that can be read"

local function refuse()
  error(REFUSAL, 0)
end

local function count_value(source, depth)
  source.values = source.values + 1
  if source.values > MOST_VALUES or depth > DEEPEST_LIST then refuse() end
end

-- If the pattern comes next, advances past it and returns its captures, or true.
local function take(source, pattern)
  local first, last, found, other = source.bytes:find("^" .. pattern, source.next)
  if first then source.next = last + 1 end
  return found or first and true, other
end

local function new_dictionary()
  return { kind = "dictionary", entries = {}, places = {} }
end

-- A repeated key keeps its first position and its last value.
local function set_entry(dictionary, key, value)
  local known = dictionary.places[key]
  if known then
    known.value = value
  else
    local entry = { key = key, value = value }
    dictionary.entries[#dictionary.entries + 1] = entry
    dictionary.places[key] = entry
  end
end

-- The node under a key; nothing if it is missing or the parent is not a dictionary.
local function find(node, key)
  local entry = node.kind == "dictionary" and node.places[key]
  return entry and entry.value or nil
end

-- The number of a node if it is a signed 32-bit number.
local function int32_of(node)
  local number = node.number
  local is_whole = number and number == math.floor(number)
  return is_whole and number >= -2 ^ 31 and number < 2 ^ 31 and number or nil
end

-- UTF-8

local UTF8_SHAPES = {
  "^[\194-\223][\128-\191]()",
  "^\224[\160-\191][\128-\191]()",
  "^[\225-\236\238\239][\128-\191][\128-\191]()",
  "^\237[\128-\159][\128-\191]()",
  "^\240[\144-\191][\128-\191][\128-\191]()",
  "^[\241-\243][\128-\191][\128-\191][\128-\191]()",
  "^\244[\128-\143][\128-\191][\128-\191]()",
}

local function past_character(text, at)
  for _, shape in ipairs(UTF8_SHAPES) do
    local past = text:match(shape, at)
    if past then return past end
  end
  return nil
end

local function is_utf8(text)
  local at = text:find("[\128-\255]")
  while at do
    local past = past_character(text, at)
    if not past then return false end
    at = text:find("[\128-\255]", past)
  end
  return true
end

local function utf8_of(code)
  local function follower(place)
    return 0x80 + math.floor(code / 64 ^ place) % 64
  end
  if code < 0x80 then return string.char(code) end
  if code < 0x800 then return string.char(0xC0 + math.floor(code / 64), follower(0)) end
  if code < 0x10000 then
    return string.char(0xE0 + math.floor(code / 64 ^ 2), follower(1), follower(0))
  end
  return string.char(0xF0 + math.floor(code / 64 ^ 3), follower(2), follower(1), follower(0))
end

-- Texts of scalars, as `pallax decode` writes them

-- The shortest text that reads back the same; without an exponent if that is not longer.
local function real_text(number)
  if number ~= number or math.abs(number) == math.huge then return "null" end
  local text
  for precision = 0, 16 do
    text = string.format("%." .. precision .. "e", number)
    if tonumber(text) == number then break end
  end
  local sign, digits, power = text:match("^(%-?)([%d.]+)e([+-]%d+)$")
  digits, power = digits:gsub("%.", ""), tonumber(power)
  local plain
  if power >= #digits - 1 then
    plain = digits .. string.rep("0", power + 1 - #digits)
  elseif power >= 0 then
    plain = digits:sub(1, power + 1) .. "." .. digits:sub(power + 2)
  else
    plain = "0." .. string.rep("0", -power - 1) .. digits
  end
  if #sign + #plain > #text then return text end
  return math.abs(number) >= 2 ^ 53 and string.format("%.0f", number) or sign .. plain
end

local BASE64 = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/"

local function base64_text(bytes)
  local letters = {}
  for at = 1, #bytes, 3 do
    local first, second, third = bytes:byte(at, at + 2)
    local group = first * 65536 + (second or 0) * 256 + (third or 0)
    for place = 3, 0, -1 do
      local digit = math.floor(group / 64 ^ place) % 64 + 1
      letters[#letters + 1] = BASE64:sub(digit, digit)
    end
    if not third then letters[#letters] = "=" end
    if not second then letters[#letters - 1] = "=" end
  end
  return table.concat(letters)
end

-- The same for a base64 text, which may contain white space; nothing if it is invalid.
local function checked_base64(text)
  text = text:gsub("[ \t\r\n]", "")
  local digits, padding = text:match("^([A-Za-z0-9+/]*)(=?=?)$")
  if not digits or #text % 4 ~= 0 then return nil end
  local last = BASE64:find(digits:sub(-1), 1, true)
  local unused = padding == "=" and 4 or padding == "==" and 16 or 1
  return (digits == "" or (last - 1) % unused == 0) and text or nil
end

local function is_leap(year)
  return year % 4 == 0 and year % 100 ~= 0 or year % 400 == 0
end

-- "2023-11-14T22:13:20Z" if it is a date, otherwise nothing.
local function checked_date(text)
  local year, month, day, hour, minute, second =
    text:match("^(%d%d%d%d)%-(%d%d)%-(%d%d)T(%d%d):(%d%d):(%d%d)Z$")
  if not year then return nil end
  local lengths = { 31, is_leap(tonumber(year)) and 29 or 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31 }
  local length = lengths[tonumber(month)]
  local is_date = length and tonumber(day) >= 1 and tonumber(day) <= length
  return is_date and tonumber(hour) < 24 and tonumber(minute) < 60 and tonumber(second) < 60
    and text or nil
end

-- The same for seconds since 2001; nothing outside the years 0 to 9999. Years start in March, so that
-- the leap day is the last.
local function date_text(seconds)
  if not (math.abs(seconds) < 1e12) then return nil end
  seconds = math.floor(seconds)
  local days = math.floor(seconds / SECONDS_OF_DAY)
  local rest = seconds - days * SECONDS_OF_DAY
  days = days + 730791 -- since the first of March of the year 0
  local era = math.floor(days / 146097)
  days = days - era * 146097
  local year = math.floor((days - math.floor(days / 1460) + math.floor(days / 36524)
    - math.floor(days / 146096)) / 365)
  days = days - 365 * year - math.floor(year / 4) + math.floor(year / 100)
  local month = math.floor((5 * days + 2) / 153)
  local day = days - math.floor((153 * month + 2) / 5) + 1
  year = year + 400 * era + (month >= 10 and 1 or 0)
  month = month + (month >= 10 and -9 or 3)
  if year < 0 or year > 9999 then return nil end
  return string.format("%04.0f-%02.0f-%02.0fT%02.0f:%02.0f:%02.0fZ", year, month, day,
    math.floor(rest / 3600), math.floor(rest / 60) % 60, rest % 60)
end

-- The binary form: "bplist00", the objects, a table of their offsets, and a trailer. Offsets count
-- from 0; numbers are big-endian.

local HEADER, TRAILER = "bplist00", 32
local INTEGER, DATA, ASCII, UTF16, UTF8, ARRAY, DICTIONARY = 1, 4, 5, 6, 7, 10, 13

local function big_endian(source, at, width, limit)
  if at + width > limit then refuse() end
  local number = 0.0
  for index = at + 1, at + width do number = number * 256 + source.bytes:byte(index) end
  return number
end

-- Reads the trailer.
local function open_binary(source)
  local size = #source.bytes
  local trailer = size - TRAILER
  if source.bytes:sub(1, #HEADER) ~= HEADER or trailer < #HEADER then refuse() end
  source.offset_width = big_endian(source, trailer + 6, 1, size)
  source.width = big_endian(source, trailer + 7, 1, size)
  source.count = big_endian(source, trailer + 8, 8, size)
  source.root = big_endian(source, trailer + 16, 8, size)
  source.objects_end = big_endian(source, trailer + 24, 8, size)
  local is_sound = source.offset_width >= 1 and source.offset_width <= 8
    and source.width >= 1 and source.width <= 8
    and source.objects_end > #HEADER and source.objects_end <= trailer
    and source.count * source.offset_width == trailer - source.objects_end
    and source.root < source.count
  if not is_sound then refuse() end
  source.scalars = {}
  source.payload = size + MOST_EXPANDED
end

local function offset_of(source, reference)
  if reference >= source.count then refuse() end
  local at = source.objects_end + reference * source.offset_width
  local offset = big_endian(source, at, source.offset_width, #source.bytes)
  if offset < #HEADER or offset >= source.objects_end then refuse() end
  return offset
end

local function marker_at(source, offset)
  local byte = source.bytes:byte(offset + 1)
  local marker = { kind = math.floor(byte / 16), low = byte % 16, content = offset + 1 }
  local kind = marker.kind
  marker.count = marker.low
  local is_counted = kind >= DATA and kind <= UTF8 or kind == ARRAY or kind == DICTIONARY
  if is_counted and marker.low == 15 then
    local size = big_endian(source, marker.content, 1, source.objects_end) - 16 * INTEGER
    if size < 0 or size > 3 then refuse() end
    marker.count = big_endian(source, marker.content + 1, 2 ^ size, source.objects_end)
    marker.content = marker.content + 1 + 2 ^ size
  end
  return marker
end

-- The content of an object whose units have `unit` bytes each.
local function content_of(source, marker, unit)
  marker.past = marker.content + marker.count * unit
  if marker.past > source.objects_end then refuse() end
  return source.bytes:sub(marker.content + 1, marker.past)
end

-- Texts and data may overlap; their expansion is limited in proportion to the bytes.
local function spend(source, size)
  source.payload = source.payload - size
  if source.payload < 0 then refuse() end
end

local function text_of_utf16(units)
  local letters, at = {}, 1
  while at < #units do
    local code = units:byte(at) * 256 + units:byte(at + 1)
    at = at + 2
    if code >= 0xD800 and code <= 0xDFFF then
      local low = at < #units and units:byte(at) * 256 + units:byte(at + 1) or 0
      if code >= 0xDC00 or low < 0xDC00 or low > 0xDFFF then refuse() end
      code = 0x10000 + (code - 0xD800) * 1024 + low - 0xDC00
      at = at + 2
    end
    letters[#letters + 1] = utf8_of(code)
  end
  return table.concat(letters)
end

local function binary_text(source, marker)
  local bytes = content_of(source, marker, marker.kind == UTF16 and 2 or 1)
  spend(source, #bytes)
  if marker.kind == UTF16 then return text_of_utf16(bytes) end
  if marker.kind == ASCII and bytes:find("[\128-\255]") or not is_utf8(bytes) then refuse() end
  return bytes
end

-- 1, 2 or 4 bytes are unsigned, 8 signed; 16 are accepted if the number fits 64 bits, signed or
-- unsigned.
local function binary_integer(source, marker)
  if marker.low > 4 then refuse() end
  local at, width, is_unsigned = marker.content, 2 ^ marker.low, false
  marker.past = at + width
  if width == 16 then
    local high = source.bytes:sub(at + 1, at + 8)
    width, at = 8, at + 8
    local is_top_bit_set = big_endian(source, at, 1, source.objects_end) >= 128
    is_unsigned = high == string.rep("\0", 8)
    if not is_unsigned and (high ~= string.rep("\255", 8) or not is_top_bit_set) then refuse() end
  end
  if width < 8 then
    local number = big_endian(source, at, width, source.objects_end)
    return number, string.format("%.0f", number)
  end
  -- In halves, with the text computed separately: a Lua number may not hold all of the bits.
  local low = big_endian(source, at + 4, 4, source.objects_end)
  local high = big_endian(source, at, 4, source.objects_end)
  local range = source.range:range(at, 8)
  if is_unsigned then return high * 2 ^ 32 + low, tostring(range:uint64()) end
  return signed(high, 32) * 2 ^ 32 + low, tostring(range:int64())
end

local function binary_real(source, marker)
  if marker.low ~= 2 and marker.low ~= 3 then refuse() end
  marker.past = marker.content + 2 ^ marker.low
  if marker.past > source.objects_end then refuse() end
  return source.range:range(marker.content, 2 ^ marker.low):float()
end

local scalars = {}

scalars[0] = function(_, marker)
  if marker.low ~= 8 and marker.low ~= 9 then refuse() end
  marker.past = marker.content
  return { kind = "boolean", text = marker.low == 9 and "true" or "false" }
end

scalars[INTEGER] = function(source, marker)
  local number, text = binary_integer(source, marker)
  return { kind = "integer", number = number, text = text }
end

scalars[2] = function(source, marker)
  local number = binary_real(source, marker)
  return { kind = "real", number = number, text = real_text(number) }
end

scalars[3] = function(source, marker)
  local text = marker.low == 3 and date_text(binary_real(source, marker))
  return { kind = "date", text = text or refuse() }
end

scalars[DATA] = function(source, marker)
  local bytes = content_of(source, marker, 1)
  spend(source, #bytes)
  return { kind = "data", text = base64_text(bytes) }
end

scalars[ASCII] = function(source, marker)
  return { kind = "string", text = binary_text(source, marker) }
end
scalars[UTF16], scalars[UTF8] = scalars[ASCII], scalars[ASCII]

local function binary_scalar(source, offset, marker)
  local known = source.scalars[offset]
  if known then return known end
  local read = scalars[marker.kind] or refuse()
  local node = read(source, marker)
  node.at, node.length = offset, marker.past - offset
  source.scalars[offset] = node
  return node
end

-- The maximum depth also ends circular references.
local function binary_value(source, offset, depth)
  count_value(source, depth)
  local marker = marker_at(source, offset)
  local is_dictionary = marker.kind == DICTIONARY
  if not is_dictionary and marker.kind ~= ARRAY then
    return binary_scalar(source, offset, marker)
  end
  content_of(source, marker, (is_dictionary and 2 or 1) * source.width)
  local function reference(index)
    local at = marker.content + index * source.width
    return offset_of(source, big_endian(source, at, source.width, source.objects_end))
  end
  local node = is_dictionary and new_dictionary() or { kind = "array", elements = {} }
  for index = 0, marker.count - 1 do
    if is_dictionary then
      local value = binary_value(source, reference(marker.count + index), depth + 1)
      local key_offset = reference(index)
      local key = binary_scalar(source, key_offset, marker_at(source, key_offset))
      if key.kind == "string" then
        set_entry(node, key.text, value)
      else
        node.entries[#node.entries + 1] = { value = value } -- counted, but never displayed
      end
    else
      node.elements[index + 1] = binary_value(source, reference(index), depth + 1)
    end
  end
  node.at, node.length = offset, marker.past - offset
  return node
end

local function read_binary(source)
  open_binary(source)
  return binary_value(source, offset_of(source, source.root), 1)
end

-- The XML form as programs write it: reads a declaration, a document type, comments between elements,
-- and references, but no attributes (except the list's version), CDATA sections or comments inside
-- texts.

local ENTITIES = { lt = "<", gt = ">", amp = "&", quot = '"', apos = "'" }

-- White space and comments.
local function skip_xml_space(source)
  take(source, "%s*")
  while take(source, "<!%-%-") do
    local _, last = source.bytes:find("-->", source.next, true)
    source.next = (last or refuse()) + 1
    take(source, "%s*")
  end
end

local function character(digits)
  local code = digits:match("^x%x+$") and tonumber(digits:sub(2), 16)
    or digits:match("^%d+$") and tonumber(digits, 10)
  local is_character = code and code <= 0x10FFFF and (code < 0xD800 or code > 0xDFFF)
    and (code >= 0x20 or code == 9 or code == 10 or code == 13)
  return is_character and utf8_of(code) or refuse()
end

-- A text with its references replaced.
local function plain_text(text)
  text = text:gsub("\r\n?", "\n")
  local rest = text:gsub("&#?%w+;", "")
  if rest:find("&", 1, true) then refuse() end
  text = text:gsub("&(#?)(%w+);", function(number, name)
    return number == "#" and character(name) or ENTITIES[name] or refuse()
  end)
  return text
end

-- The text up to the end tag of an element, and its position.
local function text_of_element(source, name)
  local at = source.next
  local text = take(source, "([^<]*)")
  local past = source.next
  if not take(source, "</" .. name .. "%s*>") then refuse() end
  return plain_text(text), at, past
end

local function trimmed(text)
  return text:match("^[ \t\r\n]*(.-)[ \t\r\n]*$")
end

-- The number and its text, with any number of digits.
local function integer_of(text)
  local sign, digits = trimmed(text):match("^([+-]?)(%d+)$")
  if not sign then
    sign, digits = trimmed(text):match("^([+-]?)0[xX](%x+)$")
    if not sign or #digits:gsub("^0+", "") > 13 then refuse() end
    digits = string.format("%.0f", tonumber(digits, 16))
  end
  digits = digits:gsub("^0+(%d)", "%1")
  sign = sign == "-" and digits ~= "0" and "-" or ""
  local largest = sign == "-" and "9223372036854775808" or "18446744073709551615"
  if #digits > #largest or #digits == #largest and digits > largest then refuse() end
  return tonumber(sign .. digits), sign .. digits
end

local function real_of(text)
  local sign, digits = trimmed(text):match("^([+-]?)(.*)$")
  local lower, number = digits:lower(), nil
  if lower == "nan" then
    number = 0 / 0
  elseif lower == "inf" or lower == "infinity" then
    number = math.huge
  else
    local significand = digits:match("^([%d.]+)$") or digits:match("^([%d.]+)[eE][+-]?%d+$")
    local is_real = significand and significand:find("^%d*%.?%d*$") and significand:find("%d")
    number = (is_real and tonumber(digits) or refuse()) + 0.0 -- a real, even if Lua has integers
    local is_in_range = number > 0 and number < math.huge
    if not is_in_range and significand:find("[1-9]") then refuse() end
  end
  return sign == "-" and -number or number
end

local xml_scalars = {}

xml_scalars.string = function(text) return text end
xml_scalars.integer = function(text)
  local number, digits = integer_of(text)
  return digits, number
end
xml_scalars.real = function(text)
  local number = real_of(text)
  return real_text(number), number
end
xml_scalars.data = function(text) return checked_base64(text) end
xml_scalars.date = function(text) return checked_date(trimmed(text)) end

local function xml_scalar(source, name, first, is_empty)
  local text, at, past = "", first, first
  if not is_empty then text, at, past = text_of_element(source, name) end
  local node = { kind = name }
  if name == "true" or name == "false" then
    if trimmed(text) ~= "" then refuse() end
    node.kind, node.text = "boolean", name
  else
    local read = xml_scalars[name] or refuse()
    node.text, node.number = read(text)
    if not node.text then refuse() end
  end
  if at == past then at, past = first, source.next end -- if empty, the element itself
  node.at, node.length = at - 1, past - at
  return node
end

local xml_value -- defined below: containers are recursive

local function fill_container(source, node, depth)
  skip_xml_space(source)
  while not take(source, "</" .. (node.elements and "array" or "dict") .. "%s*>") do
    if node.elements then
      node.elements[#node.elements + 1] = xml_value(source, depth + 1)
    else
      local is_empty = take(source, "<key%s*/>")
      if not is_empty and not take(source, "<key%s*>") then refuse() end
      local key = is_empty and "" or text_of_element(source, "key")
      skip_xml_space(source)
      set_entry(node, key, xml_value(source, depth + 1))
    end
    skip_xml_space(source)
  end
end

function xml_value(source, depth)
  count_value(source, depth)
  local first = source.next
  local name, ending = take(source, "<(%a+)%s*(/?)>")
  if name ~= "dict" and name ~= "array" then
    return xml_scalar(source, name or refuse(), first, ending == "/")
  end
  local node = name == "dict" and new_dictionary() or { kind = "array", elements = {} }
  if ending == "" then fill_container(source, node, depth) end
  node.at, node.length = first - 1, source.next - first
  return node
end

-- The part before the list.
local function take_prolog(source)
  take(source, "\239\187\191")
  local declaration = take(source, "(<%?xml%s[^?<>&]*%?>)")
  if declaration and declaration:find("encoding", 1, true) then
    local at = declaration:find("encoding", 1, true)
    local _, encoding = declaration:match("^encoding%s*=%s*([\"'])([%w-]+)%1", at)
    encoding = (encoding or refuse()):upper()
    if encoding ~= "UTF-8" and encoding ~= "US-ASCII" then refuse() end
  end
  skip_xml_space(source)
  local document_type = take(source, "<!DOCTYPE(%s[^%[<>']*)>")
  if document_type then
    local _, quotes = document_type:gsub('"', "")
    if quotes % 2 ~= 0 then refuse() end
  end
  skip_xml_space(source)
end

local function read_xml(source)
  if not is_utf8(source.bytes) or source.bytes:find("[%z\1-\8\11\12\14-\31]") then refuse() end
  source.next = 1
  take_prolog(source)
  if not take(source, "<plist%s*>") and not take(source, '<plist%s+version="[^"<>&]*"%s*>') then
    refuse()
  end
  skip_xml_space(source)
  local node = xml_value(source, 1)
  skip_xml_space(source)
  if not take(source, "</plist%s*>") then refuse() end
  skip_xml_space(source)
  if source.next <= #source.bytes then refuse() end
  return node
end

-- The old text form: { key = value; }, ( a, b ), <0fbd77>, "quoted" or bare strings, comments as in
-- C++.

local ESCAPES = {
  a = "\a", b = "\b", f = "\f", n = "\n", r = "\r", t = "\t", v = "\v",
  ['"'] = '"', ["'"] = "'", ["\\"] = "\\", ["\n"] = "\n",
}

local function skip_text_space(source)
  repeat
    take(source, "[ \t-\r]*")
    local is_comment = take(source, "//[^\r\n]*")
    if take(source, "/%*") then
      local _, last = source.bytes:find("*/", source.next, true)
      source.next = (last or refuse()) + 1
      is_comment = true
    end
  until not is_comment
end

-- The code point after "\U"; two escapes may form one.
local function unicode_escape(source)
  local code = tonumber(take(source, "[Uu](%x%x%x%x)") or refuse(), 16)
  if code < 0xD800 or code > 0xDFFF then return utf8_of(code) end
  local low = tonumber(take(source, "\\[Uu](%x%x%x%x)") or refuse(), 16)
  if code >= 0xDC00 or low < 0xDC00 or low > 0xDFFF then refuse() end
  return utf8_of(0x10000 + (code - 0xD800) * 1024 + low - 0xDC00)
end

local function escape(source)
  local octal = take(source, "([0-7][0-7]?[0-7]?)")
  if octal then
    local code = tonumber(octal, 8)
    return code <= 0xFF and utf8_of(code) or refuse()
  end
  if source.bytes:find("^[Uu]", source.next) then return unicode_escape(source) end
  return ESCAPES[take(source, "(.)") or refuse()] or refuse()
end

local function string_of(source)
  local quote = take(source, "([\"'])")
  if not quote then return take(source, "([A-Za-z0-9_$/:.-]+)") or refuse() end
  local pieces = {}
  while not take(source, quote) do
    local piece = take(source, "([^\\" .. quote .. "]+)")
    pieces[#pieces + 1] = piece or take(source, "\\") and escape(source) or refuse()
  end
  return table.concat(pieces)
end

local function data_of(source)
  local digits = take(source, "<([%x \t-\r]*)>") or refuse()
  digits = digits:gsub("%X", "")
  if #digits % 2 ~= 0 then refuse() end
  return base64_text((digits:gsub("%x%x", function(byte) return string.char(tonumber(byte, 16)) end)))
end

local text_value -- defined below: containers are recursive

local function fill_text_container(source, node, depth)
  local is_array = node.kind == "array"
  local closing, separator = is_array and "%)" or "}", is_array and "," or ";"
  skip_text_space(source)
  while not take(source, closing) do
    if is_array then
      node.elements[#node.elements + 1] = text_value(source, depth + 1)
    else
      local key = string_of(source)
      skip_text_space(source)
      if not take(source, "=") then refuse() end
      set_entry(node, key, text_value(source, depth + 1))
    end
    skip_text_space(source)
    local is_followed = take(source, separator)
    skip_text_space(source)
    if not is_followed and not source.bytes:find("^" .. closing, source.next) then refuse() end
  end
end

function text_value(source, depth)
  skip_text_space(source)
  count_value(source, depth)
  local first = source.next
  local node
  if take(source, "{") then
    node = new_dictionary()
    fill_text_container(source, node, depth)
  elseif take(source, "%(") then
    node = { kind = "array", elements = {} }
    fill_text_container(source, node, depth)
  elseif source.bytes:find("^<", first) then
    node = { kind = "data", text = data_of(source) }
  else
    node = { kind = "string", text = string_of(source) }
  end
  node.at, node.length = first - 1, source.next - first
  return node
end

local function read_text(source)
  if not is_utf8(source.bytes) then refuse() end
  source.next = 1
  take(source, "\239\187\191")
  local node = text_value(source, 1)
  skip_text_space(source)
  if source.next <= #source.bytes then refuse() end
  return node
end

-- The displayed parts of property lists.

local RADIO_ACCESS_TECHNOLOGY = "kHXCellMonitorCellRadioAccessTechnology"
local CELL_TYPE = "kHXCellMonitorCellType"

local readers = { binary = read_binary, XML = read_xml, text = read_text }

local function form_of(bytes)
  if bytes:find("^bplist") then return "binary" end
  if bytes:find("^\254\255") or bytes:find("^\255\254") then return "XML" end -- UTF-16
  local start = bytes:match("^\239\187\191()") or 1
  return bytes:find("^[ \t\r\n]*<[?!p]", start) and "XML" or "text"
end

-- The bytes, their form and the root node, which is nil if they cannot be read.
local function read_property_list(range)
  local bytes = range:raw()
  local list = { range = range, form = form_of(bytes) }
  local source = { range = range, bytes = bytes, values = 0 }
  local is_read, result = pcall(readers[list.form], source)
  if not is_read and result ~= REFUSAL then error(result, 0) end
  list.root = is_read and result or nil
  return list
end

local function add_list_label(tree, list)
  local label = string.format("Property list, %s, %d bytes", list.form, list.range:len())
  local item = tree:add(list.range, label)
  if not list.root then item:append_text(" (not read)") end
end

-- An untrusted text in one line.
local function printable(text)
  return (text:gsub("\194[\128-\159]", "\239\191\189"):gsub("%c", "\239\191\189"))
end

-- Values shown as sent

local function range_of_node(list, node)
  return list.range:range(node.at, node.length)
end

local add_entries -- defined below: values may be nested

local function add_elements(context, tree, elements, filters)
  for index, node in ipairs(elements) do
    local range = range_of_node(context.list, node)
    if node.text then
      tree:add(range, printable(node.text))
    else
      add_entries(context, tree:add(range, "Entry " .. (index - 1)), node, filters)
    end
  end
end

-- A value under a key; `filter` is the key's filter field if known, and `filters` the same for the
-- keys inside the value.
local function add_value(context, tree, key, node, filter, filters)
  local range = range_of_node(context.list, node)
  if node.text then
    add_labelled(context, tree, filter, range, node.text, nil, printable(key .. ": " .. node.text))
  else
    add_entries(context, tree:add(range, printable(key)), node, filters)
  end
end

function add_entries(context, tree, node, filters)
  if node.elements then return add_elements(context, tree, node.elements, filters) end
  for _, entry in ipairs(node.entries) do
    if entry.key then
      add_value(context, tree, entry.key, entry.value, filters and filters[entry.key], filters)
    end
  end
end

-- The cell monitor

local function is_cell(node, wanted)
  local technology, cell_type = find(node, RADIO_ACCESS_TECHNOLOGY), find(node, CELL_TYPE)
  if not technology or not cell_type then return false end
  local is_type = cell_type.kind == "string" and cell_type.text == wanted.cell_type
  for _, name in ipairs(wanted.technologies) do
    if is_type and technology.kind == "string" and technology.text == name then return true end
  end
  return false
end

local function cells_of(root, wanted)
  local cells = {}
  for _, node in ipairs(root.elements or {}) do
    if is_cell(node, wanted) then cells[#cells + 1] = node end
  end
  return cells
end

-- The last cell with a number for a field remains.
local function add_cell_fields(context, tree, fields, cells)
  for _, field in ipairs(fields) do
    local shown
    for _, cell in ipairs(cells) do
      local node = find(cell, field.list_key)
      shown = node and int32_of(node) and node or shown
    end
    if shown then
      local number = int32_of(shown)
      local text, value = text_of(field, field.low_bits and signed(number, field.low_bits) or number)
      add_item(context, tree, field, range_of_node(context.list, shown), text, value)
    end
  end
end

-- Sections

local list_sections = {}

list_sections["keys"] = function(context, root, part)
  local node = context.list.root
  local tree = root:add(range_of_node(context.list, node), part.head.section)
  for _, field in ipairs(part.fields) do
    local value = find(node, field.list_key)
    if value then add_value(context, tree, field.key, value, field.filter) end
  end
end

list_sections["elements"] = function(context, root, part)
  local node = context.list.root
  local tree = root:add(range_of_node(context.list, node), part.head.section)
  if node.elements then
    add_elements(context, tree, node.elements)
  else
    tree:append_text(" (no array)")
  end
end

list_sections["each cell"] = function(context, root, part)
  local cells = cells_of(context.list.root, part.list)
  local last = cells[#cells] or context.list.root
  local tree = root:add(range_of_node(context.list, last), part.head.section)
  if #cells == 0 then tree:append_text(" (no such cell)") end
  add_cell_fields(context, tree, part.fields, cells)
end

list_sections["first cell"] = function(context, root, part)
  local first = cells_of(context.list.root, part.list)[1]
  local tree = root:add(range_of_node(context.list, first or context.list.root), part.head.section)
  if not first then return tree:append_text(" (no such cell)") end
  add_cell_fields(context, tree, part.fields, { first })
end

list_sections["cell entries"] = function(context, root, part)
  local tree = root:add(range_of_node(context.list, context.list.root), part.head.section)
  for index, cell in ipairs(cells_of(context.list.root, part.list)) do
    local entry = tree:add(range_of_node(context.list, cell), "Entry " .. (index - 1))
    add_cell_fields(context, entry, part.fields, { cell })
  end
end

-- The sections of a log record whose body is a property list.
local function add_list_sections(context, tree, parts)
  local has_body = context.record:len() > HEADER_LENGTH
  context.list = has_body and read_property_list(context.record:range(HEADER_LENGTH))
    or { range = context.record:range() }
  for _, part in ipairs(parts) do
    if context.list.root then
      list_sections[part.list.part](context, tree, part)
    else
      tree:add(context.list.range, part.head.section):append_text(" (not read)")
    end
  end
  if has_body then add_list_label(tree, context.list) end
end

-- Object streams

local folded -- defined below: objects are nested

-- Replaces a dictionary with one entry by its value, and omits the first element of an array. Nothing
-- if a value has a type that objects cannot contain.
local function display_form(node)
  if node.kind == "string" then return node end
  local form = { kind = node.kind, at = node.at, length = node.length }
  if node.kind == "dictionary" then
    form.entries = {}
    for index, entry in ipairs(node.entries) do
      local value = folded(entry.value)
      if not value then return nil end
      form.entries[index] = { key = entry.key, value = value }
    end
    return form
  end
  if node.kind ~= "array" then return nil end
  form.elements = {}
  for index, element in ipairs(node.elements) do
    local value = folded(element)
    if not value then return nil end
    form.elements[index - 1] = value
  end
  form.elements[0] = nil
  return form
end

function folded(node)
  local form = display_form(node)
  local is_single = form and form.entries and #form.entries == 1
  return is_single and form.entries[1].value or form
end

local function add_object_sections(context, tree, form)
  for _, entry in ipairs(form.entries) do
    local known = context.technology.objects[entry.key] or {}
    if entry.key then
      add_value(context, tree, entry.key, entry.value, known.filter, known.keys)
    end
  end
end

local function dissect_object(technology, buffer, pinfo, tree)
  local context = { technology = technology, pinfo = pinfo }
  context.list = read_property_list(buffer:range())
  local form = context.list.root and display_form(context.list.root)
  if form and form.entries then
    add_object_sections(context, tree, form)
  elseif form and form.elements then
    add_elements(context, tree, form.elements)
  elseif form then
    tree:add(range_of_node(context.list, form), printable(form.text))
  elseif context.list.root then
    tree:append_text(" (an object of an unknown type)")
  end
  add_list_label(tree, context.list)
end

-- Records

-- The start of the subpacket; nothing if it is missing.
local function subpacket_start(record, id)
  local start = FIRST_SUBPACKET
  for _ = 1, byte_at(record, SUBPACKET_COUNT) do
    local last = start + number_at(record, start, whole_bytes(2, 2))
    if last >= FIRST_SUBPACKET + record:len() then return nil end
    if byte_at(record, start) == id then return start end
    start = last
  end
  return nil
end

local function add_subpackets(context, tree, subpackets)
  for _, subpacket in ipairs(subpackets) do
    context.subpackets[subpacket.id] = subpacket_start(context.record, subpacket.id)
    if not context.subpackets[subpacket.id] then
      return tree:append_text(" (without subpacket " .. subpacket.id .. ")")
    end
  end
  for _, subpacket in ipairs(subpackets) do
    add_parts(inside(context, context.subpackets[subpacket.id]), tree, subpacket)
  end
end

local function add_section(context, root, part)
  local head, length = part.head, context.record:len()
  local tree = root:add(context.record:range(), head.section)
  context = inside(context, 0)
  context.part, context.subpackets = part, {}
  if length < head.least or head.exact and length ~= head.least then
    tree:append_text(" (of another length)")
  elseif head.condition and not holds(context, head.condition) then
    tree:append_text(" (of another version)")
  else
    add_parts(context, tree, part)
    if part.subpackets then add_subpackets(context, tree, part.subpackets) end
  end
end

-- The log record without its transport prefix; nothing if it is empty.
local function without_prefix(buffer)
  if buffer:len() == 0 then return nil end
  if byte_at(buffer, 0) ~= PREFIX then return buffer end
  if buffer:len() <= PREFIX_LENGTH then return nil end
  return buffer(PREFIX_LENGTH):tvb()
end

local function code_of(record)
  local code = number_at(record, 0, whole_bytes(3, 2))
  return byte_at(record, 0) == EXTENDED_TYPE and EXTENDED_CODES + code or code
end

local function add_header(technology, record, tree, code, name)
  local header = technology.header
  tree:add(header.type, record(0, 1))
  local label = string.format("Log code: 0x%04X", code) .. (name and ", " .. name or "")
  tree:add(header.code, record(3, 2), code, label)
  tree:add(header.name, record(3, 2), name or "", "Name: " .. (name or "unknown"))
  tree:add(header.length, record:range(), record:len()):set_generated()
end

local function dissect_record(technology, buffer, pinfo, tree)
  local record = without_prefix(buffer)
  local is_strict = technology.framing == "record"
  local measured = is_strict and record or buffer
  if not record or measured:len() < HEADER_LENGTH or record:len() < 5 then
    return tree:append_text(" (too short)")
  end
  local code = code_of(record)
  local known = technology.codes[code]
  add_header(technology, record, tree, code, known and known.name)
  pinfo.cols.info = string.format("0x%04X", code) .. (known and " " .. known.name or "")
  local type = byte_at(record, 0)
  if is_strict and type ~= STANDARD_TYPE and type ~= EXTENDED_TYPE then
    return tree:append_text(" (invalid log type)")
  end
  local context = { technology = technology, record = record, pinfo = pinfo, start = 0 }
  local of_lists = {}
  for _, part in ipairs(known or {}) do
    if part.list then
      of_lists[#of_lists + 1] = part
    else
      add_section(context, tree, part)
    end
  end
  if #of_lists > 0 then add_list_sections(context, tree, of_lists) end
end

-- Registration

local function each_field(part, see)
  for _, field in ipairs(part.fields or {}) do see(field) end
  for _, list in ipairs(part.lists or {}) do each_field(list, see) end
  for _, subpacket in ipairs(part.subpackets or {}) do each_field(subpacket, see) end
end

-- The keys of an object stream as fields whose values are texts.
local function each_object_key(technology, see)
  for section, known in pairs(technology.objects or {}) do
    see({ key = section, filter = known.filter })
    for key, filter in pairs(known.keys) do see({ key = key, filter = filter }) end
  end
end

-- A filter field for each key: a number if every value of the key is one.
local function make_fields(technology)
  technology.fields = {}
  local names = {}
  local function see(field)
    local known = technology.fields[field.filter] or { is_number = true, name = field.key }
    known.is_number = known.is_number and field.format ~= nil
    if not technology.fields[field.filter] then names[#names + 1] = field.filter end
    technology.fields[field.filter] = known
  end
  for _, code in pairs(technology.codes) do
    for _, part in ipairs(code) do each_field(part, see) end
  end
  each_object_key(technology, see)
  local all = {}
  for _, name in ipairs(names) do
    local known = technology.fields[name]
    local make = known.is_number and ProtoField.double or ProtoField.string
    known.field = make(technology.name .. "." .. name, known.name ~= "" and known.name or name)
    all[#all + 1] = known.field
  end
  return all
end

local function register(technology)
  local proto = Proto(technology.name, technology.title .. " log record")
  local fields = make_fields(technology)
  technology.header = {
    type = ProtoField.uint8(technology.name .. ".type", "Log type", base.HEX),
    code = ProtoField.uint32(technology.name .. ".code", "Log code", base.HEX),
    name = ProtoField.string(technology.name .. ".name", "Name"),
    length = ProtoField.uint32(technology.name .. ".length", "Record length"),
  }
  for _, field in pairs(technology.header) do fields[#fields + 1] = field end
  proto.fields = fields
  technology.memory, technology.remembered = {}, {}

  function proto.init()
    technology.memory, technology.remembered = {}, {}
  end

  function proto.dissector(buffer, pinfo, root)
    pinfo.cols.protocol = technology.title
    local tree = root:add(proto, buffer())
    if technology.framing == "object" then
      dissect_object(technology, buffer, pinfo, tree)
    else
      dissect_record(technology, buffer, pinfo, tree)
    end
  end

  DissectorTable.get("wtap_encap"):add(wtap[technology.encapsulation], proto)
end

for _, technology in ipairs(technologies) do register(technology) end
