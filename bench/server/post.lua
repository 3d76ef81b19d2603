-- wrk: one CIM operation, from the file that BODY names.
wrk.method = "POST"
wrk.body = io.open(os.getenv("BODY")):read("*a")
wrk.headers["Content-Type"] = "application/xml"
wrk.headers["CIMOperation"] = "MethodCall"
wrk.headers["CIMMethod"] = os.getenv("METHOD")
wrk.headers["CIMObject"] = "root/bench"

done = function(summary)
  local e = summary.errors
  io.write(string.format("RATE %.0f ERRORS %d\n", summary.requests / summary.duration * 1e6,
    e.connect + e.read + e.write + e.status + e.timeout))
end
