#!/usr/bin/env python3
"""Writes a large host description for libdtruj.so: N adapters x P FC ports
x R remote ports x L LUNs, for scale tests and benchmarks.

The output depends only on the arguments, so two runs give the same bytes.

    tools/gen_host.py --adapters 8 --ports 4 --rports 16 --luns 64 -o big.json
    DTRUJ_HOST=big.json cimhost ...

Every --cna-every'th adapter is a CNA: its FC ports are FCoE ports and it
gets --eth-ports Ethernet ports. Every fourth remote port is a tape drive
with a medium changer at LUN 1; the rest are disk arrays.
"""

import argparse
import json
import sys


def addr(*parts):
    return ":".join("%02x" % (p & 0xFF) for p in parts)


def adapter(i, args):
    hi, lo = (i >> 8) & 0xFF, i & 0xFF
    cna = args.cna_every > 0 and i % args.cna_every == 0
    node = addr(0x20, 0, 0, 0x05, 0x1E, hi, lo, 0)
    hba = {
        "wwn": node,
        "model": "Vespera-1860" if cna else "Vespera-1020",
        "serialNumber": "VSPG%06d" % i,
        "oem": "VSPR",
        "fruNum": "FRU-%04d" % i,
        "partNum": "PN%04d" % (1860 if cna else 1020),
        "oemSerialNum": "",
        "uuid": "",
        "hbaStatus": True,
        "isMezz": False,
        "pciLocation": "0000:%02x:00.0" % (i % 256),
    }
    if cna:
        hba["hbaMAC"] = addr(0x00, 0x05, 0x1E, hi, lo, 0)
    driver = {"storageDriverName": "vsprfc", "storageDriverVersion": "3.2.1.0"}
    if cna:
        driver.update({"networkDriverName": "vspreth", "networkDriverVersion": "3.2.1.0"})
    fc_ports = []
    for j in range(args.ports):
        port = {
            "wwn": addr(0x10, 0, 0, 0x05, 0x1E, hi, lo, j + 1),
            "PortSymbolicName": "%s port%d" % ("Vespera-1860" if cna else "Vespera-1020", j),
            "operatingSpeed": 10 if cna else 16,
            "supportedPortSpeeds": [10] if cna else [16, 8, 4],
            "portTypeMOFValue": 10,
            "maxFrameSize": 2112,
            "isFCoE": cna,
            "beaconState": False,
            "remotePorts": [remote(i, j, k, args) for k in range(args.rports)],
        }
        if cna:
            port["fcoeMac"] = addr(0x00, 0x05, 0x1E, hi, lo, 0x80 + j)
        else:
            port["sfp"] = {"vendorName": "VSPR OPTICS", "serialNo": "SFG%05d%02d" % (i, j),
                           "vendorPart": "57-1000012-01", "revision": "A",
                           "speed": "4,8,16 Gbps", "extendedID": "SFP", "transceiver": "16G_SW"}
        fc_ports.append(port)
    eth_ports = []
    if cna:
        for e in range(args.eth_ports):
            eth_ports.append({
                "mac": addr(0x00, 0x05, 0x1E, hi, lo, 0x40 + e),
                "ethDev": "eth%d" % (len(eth_ports) + 2 * i),
                "mtu": 1500,
                "sfp": {"vendorName": "VSPR OPTICS", "serialNo": "SFE%05d%02d" % (i, e),
                        "vendorPart": "57-0000075-01", "revision": "B", "speed": "10 Gbps",
                        "extendedID": "SFP+", "transceiver": "10G_BASE-SR"},
            })
    return {"hbaData": hba, "driver": driver,
            "firmware": {"version": "3.2.1.0", "biosVersion": "3.2.1.0"},
            "flash": {"flashStatus": True},
            "fcPorts": fc_ports, "ethPorts": eth_ports}


def remote(i, j, k, args):
    tape = k % 4 == 3
    wwn = addr(0x50, 0x06, (i >> 8), i, j, k >> 8, k, 0x01)
    if tape:
        luns = [{"number": 0, "vendor": "VSPRTAPE", "productID": "ULTRIUM-TD8     ",
                 "lunDescIdType": 8, "productSerialNumber": "TD8-%04d%02d%03d" % (i, j, k)},
                {"number": 1, "vendor": "VSPRTAPE", "productID": "TL-2000 CHANGER ",
                 "lunDescIdType": 1, "lunDescription": "VSPRTAPE-CH-%04d%02d%03d" % (i, j, k),
                 "productSerialNumber": "TL2K-%04d%02d%03d" % (i, j, k)}]
    else:
        luns = [{"number": n, "vendor": "VSPRSTOR", "productID": "ARRAY-9000      ",
                 "lunDescIdType": 3,
                 "lunDescription": "6006016%04x%02x%03x%014x" % (i, j & 0xFF, k & 0xFFF, n),
                 "productSerialNumber": "ARR-%04d%02d%03d" % (i, j, k),
                 "capacityMB": 1024 * (1 + n % 64)}
                for n in range(args.luns)]
    return {"remotePortWwn": wwn, "remoteNodeWwn": wwn[:-2] + "00",
            "deviceData": {"isTarget": True, "type": "Tape" if tape else "Disk",
                           "stateMofValue": 2},
            "lunList": luns}


def main():
    p = argparse.ArgumentParser(description=__doc__.split("\n\n")[0])
    p.add_argument("--adapters", type=int, default=4, help="number of adapters (N)")
    p.add_argument("--ports", type=int, default=2, help="FC ports per adapter (P)")
    p.add_argument("--rports", type=int, default=4, help="remote ports per FC port (R)")
    p.add_argument("--luns", type=int, default=8, help="LUNs per disk remote port (L)")
    p.add_argument("--cna-every", type=int, default=2,
                   help="every n-th adapter is a CNA; 0 for none")
    p.add_argument("--eth-ports", type=int, default=1, help="Ethernet ports per CNA")
    p.add_argument("-o", "--output", help="output file (default: standard output)")
    args = p.parse_args()
    for name in ("adapters", "ports", "rports", "luns", "eth_ports"):
        if getattr(args, name) < 0:
            p.error("--%s must not be negative" % name.replace("_", "-"))
    if args.adapters > 65535 or args.ports > 255 or args.rports > 65535:
        p.error("at most 65535 adapters, 255 ports and 65535 remote ports")
    host = {
        "host": {"osName": "Linux", "osVersion": "5.15.0", "agentVersion": "3.2.1"},
        "diagnostics": {"requireOffline": True},
        "adapters": [adapter(i, args) for i in range(1, args.adapters + 1)],
    }
    text = json.dumps(host, indent=1, sort_keys=True) + "\n"
    if args.output:
        with open(args.output, "w") as f:
            f.write(text)
    else:
        sys.stdout.write(text)


if __name__ == "__main__":
    main()
