#!/usr/bin/env python3
"""Runs the benchmarks of bench/ and prints one table: for each figure its median and the ratio
it is judged by, every ratio taken from figures measured side by side in the same run (the
repetitions of one program are interleaved). The table is also written as JSON to
build/bench/results.json. ./run bench calls it after building; it installs node-soap into
build/bench/peer (npm) and makes the WSDL node-soap reads there.

usage: bench/report.py BUILD_FOLDER [REPETITIONS]
"""
import datetime
import json
import os
import re
import shutil
import statistics
import subprocess
import sys
import tempfile

HERE = os.path.dirname(os.path.abspath(__file__))
ROOT = os.path.dirname(HERE)
BUILD = os.path.abspath(sys.argv[1] if len(sys.argv) > 1 else os.path.join(ROOT, 'build'))
BENCH = os.path.join(BUILD, 'bench')
REPETITIONS = int(sys.argv[2]) if len(sys.argv) > 2 else 5
# Client instructions of a network getTitles before this work (TLS handshake on every call, the
# runtime's id-table walk after every element).
BASELINE_INSTRUCTIONS = 13.3e6

rows = []


def row(figure, median, unit, ratio=None, judged_by=None, met=None, note=''):
    rows.append({'figure': figure, 'median': median, 'unit': unit, 'ratio': ratio, 'judged_by': judged_by,
                 'met': met, 'note': note})


def missing(figure, why):
    row(figure, None, '', note='not measured: ' + why)


def log(text):
    print(text, file=sys.stderr, flush=True)


def google_benchmark(program, pattern, repetitions=REPETITIONS, extra=(), env=None):
    """Runs a Google Benchmark program; returns {name: [the repetitions' result dicts]}."""
    out = os.path.join(BENCH, program + '.json')
    command = [os.path.join(BENCH, program), '--benchmark_filter=' + pattern,
               '--benchmark_repetitions=%d' % repetitions, '--benchmark_enable_random_interleaving=true',
               '--benchmark_out=' + out, '--benchmark_out_format=json', *extra]
    log('$ ' + ' '.join(command[:2]))
    subprocess.run(command, check=True, stdout=sys.stderr, stderr=subprocess.DEVNULL, env=env)
    runs = {}
    for result in json.load(open(out))['benchmarks']:
        if result.get('run_type') == 'iteration' and not result.get('error_occurred'):
            runs.setdefault(result['run_name'], []).append(result)
        elif result.get('error_occurred'):
            log('%s: %s' % (result['run_name'], result.get('error_message')))
    return runs


def median(runs, name, key='real_time'):
    """The median of a value over the repetitions, in seconds for times; None when it did not run."""
    values = [r[key] * (1e-9 if key in ('real_time', 'cpu_time') else 1) for r in runs.get(name, [])]
    return statistics.median(values) if values else None


def ratio(a, b):
    return a / b if a is not None and b else None


# ---- (1) a page of titles from the file cache, the memory cache and the network -------------

def titles_page():
    runs = google_benchmark('catalog_cache_bench', 'BM_TitlesPage', extra=['--benchmark_min_time=0.5'])
    network, memory, file = (median(runs, 'BM_TitlesPage/cache:%d/real_time' % c) for c in (0, 1, 2))
    if None in (network, memory, file):
        return missing('getTitles, 20 titles', 'a benchmark failed (see above)')
    row('getTitles, 20 titles, network (TLS, loopback)', network, 's')
    row('getTitles, 20 titles, memory cache', memory, 's', ratio(network, memory), 'network / memory (information)')
    r = ratio(network, file)
    row('getTitles, 20 titles, file cache', file, 's', r, 'network / file >= 40 and file < 100 us',
        r >= 40 and file < 100e-6)


# ---- (2) the next page after a prefetch -----------------------------------------------------

def next_page():
    runs = google_benchmark('prefetch_bench', 'BM_NextPage')
    cold, prefetched, hit = (median(runs, 'BM_NextPage/%s/iterations:64/real_time' % k)
                             for k in ('not_prefetched', 'prefetched', 'shown_again'))
    if None in (cold, prefetched, hit):
        return missing('next page after a prefetch', 'a benchmark failed (see above)')
    row('next page, not prefetched (network)', cold, 's', ratio(cold, prefetched), 'not prefetched / prefetched (information)')
    row('page shown again (file cache hit)', hit, 's')
    r = ratio(prefetched, hit)
    row('next page after a prefetch', prefetched, 's', r, 'prefetched / cache hit <= 1.5', r <= 1.5)


# ---- (3) client instructions per network getTitles (callgrind) ------------------------------

def inclusive(dump, function):
    """The inclusive instruction count of function in a callgrind dump (0 when not called)."""
    text = subprocess.run(['callgrind_annotate', '--inclusive=yes', '--threshold=100', dump],
                          capture_output=True, text=True).stdout
    for line in text.splitlines():
        m = re.match(r'\s*([\d,]+) .*[:?]%s \[' % re.escape(function), line)
        if m:
            return int(m.group(1).replace(',', ''))
    return 0


def instructions():
    if not shutil.which('valgrind'):
        return missing('instructions per network getTitles', 'valgrind is not installed')
    folder = tempfile.mkdtemp(prefix='callgrind.', dir=BENCH)
    # One dump per call of VL_WS_getTitles, of the calling thread only (the simulator's threads
    # are not the client's): the first call makes a full TLS handshake, the others resume.
    command = ['valgrind', '--tool=callgrind', '--separate-threads=yes', '--toggle-collect=VL_WS_getTitles',
               '--dump-after=VL_WS_getTitles', '--callgrind-out-file=' + os.path.join(folder, 'out'),
               os.path.join(BENCH, 'catalog_cache_bench'), '--benchmark_filter=BM_TitlesPage/cache:0',
               '--benchmark_min_time=1']
    log('$ valgrind --tool=callgrind catalog_cache_bench (network getTitles)')
    subprocess.run(command, check=True, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
    dumps = sorted((f for f in os.listdir(folder) if re.fullmatch(r'out\.\d+-01', f)), key=lambda f: int(f[4:-3]))
    calls = []
    for dump in dumps:
        path = os.path.join(folder, dump)
        total = int(re.search(r'^totals: (\d+)', open(path).read(), re.M).group(1))
        calls.append((total, inclusive(path, 'SSL_connect')))
    shutil.rmtree(folder)
    if len(calls) < 2:
        return missing('instructions per network getTitles', 'callgrind recorded fewer than two calls')
    steady = statistics.median(t for t, _ in calls[1:])
    handshake = statistics.median(h for _, h in calls[1:])
    r = steady / BASELINE_INSTRUCTIONS
    row('client instructions per network getTitles', steady, 'instructions', r,
        'per call / 13.3 million <= 0.5', r <= 0.5, 'median of %d calls after the first' % (len(calls) - 1))
    row('  of which the resumed TLS handshake', handshake, 'instructions', ratio(handshake, steady), 'share of the call')
    row('  first call, full TLS handshake', calls[0][0], 'instructions', ratio(calls[0][1], calls[0][0]),
        'share of the handshake (%d instructions)' % calls[0][1])


# ---- (4), (5), (6) the peers: node-soap and curl ---------------------------------------------

def prepare_node_soap():
    """Installs node-soap and writes the WSDL it reads; None when it cannot, else the reason."""
    if not shutil.which('node') or not shutil.which('npm'):
        return 'node or npm is not installed'
    peer = os.path.join(BENCH, 'peer')
    os.makedirs(peer, exist_ok=True)
    shutil.copy(os.path.join(HERE, 'peer', 'package.json'), peer)
    if not os.path.isdir(os.path.join(peer, 'node_modules', 'soap')):
        log('$ npm install (node-soap into %s)' % peer)
        done = subprocess.run(['npm', 'install', '--no-audit', '--no-fund', '--loglevel=error'], cwd=peer,
                              stdout=sys.stderr)
        if done.returncode != 0:
            return 'npm install failed'
    # The generated WSDL imports the WS-Security, WS-Addressing and signature schemas from their
    # remote locations; nothing of them is needed, so the imports stay without a location.
    wsdl = open(os.path.join(BUILD, 'soap', 'generated', 'RealTimeBrowseSoap12.wsdl')).read()
    wsdl = re.sub(r'\s+schemaLocation="(?:https?|urn):[^"]*"', '', wsdl)
    open(os.path.join(peer, 'RealTimeBrowseSoap12.wsdl'), 'w').write(wsdl)
    return None


def peers():
    why_not_node = prepare_node_soap()
    pattern = 'BM_(Client|Curl)' if why_not_node else 'BM_'
    runs = google_benchmark('peer_bench', pattern, extra=['--benchmark_min_time=0.5'])
    ours_cpu = median(runs, 'BM_ClientTitles/real_time', 'cpu')
    ours_wall = median(runs, 'BM_ClientTitles/real_time', 'wall')
    if why_not_node:
        missing('node-soap, CPU per getTitles', why_not_node)
    else:
        node = median(runs, 'BM_NodeSoapTitles/iterations:1/real_time', 'cpu')
        row('client CPU per network getTitles', ours_cpu, 's')
        r = ratio(ours_cpu, node)
        row('node-soap CPU per getTitles (series of 50)', node, 's', r, 'client / node-soap CPU <= 0.1',
            r is not None and r <= 0.1)
    curl_cpu = median(runs, 'BM_CurlPostsTheClientsRequest/real_time', 'cpu')
    curl_wall = median(runs, 'BM_CurlPostsTheClientsRequest/real_time', 'wall')
    r_wall, r_cpu = ratio(ours_wall, curl_wall), ratio(ours_cpu, curl_cpu)
    if None in (r_wall, r_cpu):
        missing('curl posting the same request', 'a benchmark failed (see above)')
    else:
        row('curl posting the same request, wall per call', curl_wall, 's', r_wall, 'client / curl wall <= 0.8',
            r_wall <= 0.8, 'client: %.3g s' % ours_wall)
        row('curl posting the same request, CPU per call', curl_cpu, 's', r_cpu, 'client / curl CPU <= 0.8',
            r_cpu <= 0.8, 'client: %.3g s' % ours_cpu)
    ours = median(runs, 'BM_ClientBoxArtToFile/real_time', 'wall')
    curl = median(runs, 'BM_CurlBoxArtToFile/real_time', 'wall')
    r = ratio(ours, curl)
    if r is None:
        return missing('box art to a file', 'a benchmark failed (see above)')
    row('box art (321) to a file, client', ours, 's')
    row('box art (321) to a file, curl', curl, 's', r, 'client / curl wall <= 1', r <= 1)


# ---- (7) memory ------------------------------------------------------------------------------

MIB = 1024 * 1024


def memory():
    runs = google_benchmark('memory_bench', 'BM_', repetitions=1,
                            env=dict(os.environ, GLIBC_TUNABLES='glibc.malloc.tcache_count=0'))
    result = runs.get('BM_CachedAndNetworkCalls/iterations:1')
    if not result:
        return missing('memory of 1,000 cached and 200 network calls', 'the benchmark failed')
    m = result[0]
    row('heap of 1,000 cached + 200 network calls, peak', m['heap_peak'], 'bytes', m['heap_peak'] / (2 * MIB),
        'library heap / 2 MiB < 1', m['heap_peak'] < 2 * MIB)
    row('  heap growth, first half to second', m['heap_growth'], 'bytes', m['heap_growth'] / m['heap_half1'],
        'growth <= 0', m['heap_growth'] <= 0, 'end of halves: %d, %d' % (m['heap_half1'], m['heap_half2']))
    row('  resident size, peak', m['rss_peak'], 'bytes', note='above the process before its first call')
    row('  resident growth, first half to second', m['rss_growth'], 'bytes', m['rss_growth'] / m['rss_half1'],
        'growth <= 0', m['rss_growth'] <= 0)
    demo_memory()


def demo_host(folder, wrapper):
    """A build folder for demo/run-demo whose vlhost runs the real one through wrapper."""
    os.makedirs(folder, exist_ok=True)
    link = os.path.join(folder, 'simulator')
    if not os.path.lexists(link):
        os.symlink(os.path.join(BUILD, 'simulator'), link)
    host = os.path.join(folder, 'vlhost')
    open(host, 'w').write('#!/usr/bin/env bash\n' + wrapper.replace('VLHOST', os.path.join(BUILD, 'vlhost')))
    os.chmod(host, 0o755)
    return folder


def run_demo(host):
    files = tempfile.mkdtemp(prefix='demo.', dir=BENCH)
    done = subprocess.run([os.path.join(ROOT, 'demo', 'run-demo'), host, files], stdout=subprocess.DEVNULL,
                          stderr=subprocess.DEVNULL)
    shutil.rmtree(files)
    return done.returncode == 0


def halves(samples):
    """The highest value of the first and of the second half of (time, value) samples."""
    end = samples[-1][0]
    first = max(v for t, v in samples if t <= end / 2)
    second = max(v for t, v in samples if t > end / 2)
    return first, second


def demo_memory():
    if not shutil.which('valgrind'):
        return missing('vlhost demo session, heap', 'valgrind is not installed')
    massif = os.path.join(BENCH, 'vlhost.massif')
    log('$ demo/run-demo with vlhost under valgrind --tool=massif')
    host = demo_host(os.path.join(BENCH, 'demo-massif'),
                     'exec valgrind --tool=massif --massif-out-file=%s VLHOST "$@"\n' % massif)
    if not run_demo(host):
        return missing('vlhost demo session, heap', 'the demo session failed under massif')
    samples = [(int(t), int(h) + int(x)) for t, h, x in
               re.findall(r'time=(\d+)\nmem_heap_B=(\d+)\nmem_heap_extra_B=(\d+)', open(massif).read())]
    first, second = halves(samples)
    end = samples[-1][0]
    resting = [[v for t, v in samples if t <= end / 2][-1], samples[-2][1]]
    row('vlhost demo session, heap peak', max(v for _, v in samples), 'bytes', note='whole process (massif)')
    row('  heap growth, peak of first half to second', second - first, 'bytes', ratio(second - first, first),
        'growth <= 0', second <= first,
        'heap at the end of the first half %d, before the teardown %d' % tuple(resting))
    # The resident size of a run at full speed, sampled every 20 ms.
    rss = os.path.join(BENCH, 'vlhost.rss')
    log('$ demo/run-demo with the resident size of vlhost sampled')
    host = demo_host(os.path.join(BENCH, 'demo-rss'),
                     'VLHOST "$@" & pid=$!\n: > %s\nwhile kill -0 $pid 2>/dev/null; do\n'
                     '  echo "$(date +%%s%%N) $(awk \'/^VmRSS/ {print $2}\' /proc/$pid/status 2>/dev/null)" >> %s\n'
                     '  sleep 0.02\ndone\nwait $pid\n' % (rss, rss))
    if not run_demo(host):
        return missing('vlhost demo session, resident size', 'the demo session failed')
    samples = [(int(t), int(k) * 1024) for t, k in re.findall(r'^(\d+) (\d+)$', open(rss).read(), re.M)]
    start = samples[0][0]
    samples = [(t - start, v) for t, v in samples]
    first, second = halves(samples)
    row('vlhost demo session, resident size peak', max(v for _, v in samples), 'bytes')
    row('  resident growth, peak of first half to second', second - first, 'bytes', ratio(second - first, first),
        'growth <= 0', second <= first)


# ---- work that grows with its input ----------------------------------------------------------

def complexity():
    """The growth that Google Benchmark fits to work on longer and longer input, for information:
    a fit over a few noisy points may take N for N log N and back."""
    out = os.path.join(BENCH, 'long_input_bench.json')
    log('$ long_input_bench')
    subprocess.run([os.path.join(BENCH, 'long_input_bench'), '--benchmark_out=' + out,
                    '--benchmark_out_format=json'], check=True, stdout=sys.stderr, stderr=subprocess.DEVNULL)
    for result in json.load(open(out))['benchmarks']:
        if result.get('aggregate_name') == 'BigO':
            row(result['run_name'][3:], None, '', note='grows as %s (fitted; information)' % result['big_o'])


# ---- the table -------------------------------------------------------------------------------

def shown(value, unit):
    if value is None:
        return ''
    if unit == 's':
        return '%.1f us' % (value * 1e6) if value < 1e-3 else '%.2f ms' % (value * 1e3)
    if unit == 'bytes':
        return '%.2f MiB' % (value / MIB) if abs(value) >= MIB / 4 else '%.1f KiB' % (value / 1024)
    if unit == 'instructions':
        return '%.2f M' % (value / 1e6)
    return '%g %s' % (value, unit)


def main():
    started = datetime.datetime.now(datetime.timezone.utc)
    for part in (titles_page, next_page, instructions, peers, memory, complexity):
        try:
            part()
        except (subprocess.CalledProcessError, OSError, ValueError, KeyError) as e:
            missing(part.__name__.replace('_', ' '), 'failed: %s' % e)
    results = {'date': started.strftime('%Y-%m-%d %H:%M UTC'), 'repetitions': REPETITIONS,
               'machine': '%d cores, %s' % (os.cpu_count(), os.uname().release), 'figures': rows}
    json.dump(results, open(os.path.join(BENCH, 'results.json'), 'w'), indent=1)
    print('Benchmarks of %s (medians of %d repetitions; %s)' % (results['date'], REPETITIONS, results['machine']))
    print('%-52s %12s %9s  %-42s %s' % ('figure', 'median', 'ratio', 'judged by', 'goal'))
    for r in rows:
        met = {True: 'met', False: 'MISSED', None: ''}[r['met']]
        print('%-52s %12s %9s  %-42s %s' % (r['figure'], shown(r['median'], r['unit']),
                                            '' if r['ratio'] is None else '%.3g' % r['ratio'], r['judged_by'] or '', met))
        if r['note']:
            print('%-52s %s' % ('', r['note']))
    print('JSON: %s' % os.path.join(BENCH, 'results.json'))


if __name__ == '__main__':
    main()
