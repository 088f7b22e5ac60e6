// Fetches the pictures, coarse to fine, and keeps as many of them decoded as memory allows.

const PARALLEL_LOADS = 6;
const PARALLEL_DECODES = 3;
const FIRST_PASS = 64; // pictures at most, so that a long walk can be seen whole at once
const LOOK_AHEAD = 24; // pictures, where not all can be kept
const MEBIBYTE = 2 ** 20;
const IS_SMALL_DEVICE = (navigator.deviceMemory ?? 8) <= 4 || matchMedia('(pointer: coarse)').matches;
const DECODED_BYTES = (IS_SMALL_DEVICE ? 160 : 400) * MEBIBYTE;
const ENCODED_BYTES = (IS_SMALL_DEVICE ? 160 : 480) * MEBIBYTE;
const GUESSED_BYTES = 200_000; // of a picture whose size nobody tells

// Every 8th picture, every 4th between them, every 2nd, the rest.
function coarseToFine(count) {
    let step = 8;
    while (count / step > FIRST_PASS) step *= 2;
    const order = [];
    for (let frame = 0; frame < count; frame += step) order.push(frame);
    for (; step > 1; step /= 2)
        for (let frame = step / 2; frame < count; frame += step) order.push(frame);
    return order;
}

class Frames {
    // first: the image element of the first picture, which the page brings.
    constructor(recording, first, changed) {
        this.recording = recording;
        this.names = recording.files;
        this.count = recording.count;
        this.cyclic = recording.kind === 'turntable';
        this.changed = changed;
        this.first = first;
        this.order = coarseToFine(this.count).filter((frame) => this.names[frame] !== null);
        this.next = 0;           // in the order
        this.encoded = new Map(); // frame: blob or image, those last needed at the end
        this.encodedBytes = 0;
        this.decoded = new Map(); // frame: bitmap
        this.loading = new Set();
        this.decoding = new Set();
        this.broken = new Set();
        this.cursor = 0;
        this.direction = 1;
        this.seen = new Set(); // pictures that were loaded once
        this.width = Infinity; // pixels that a decoded picture needs
    }

    get total() { return this.order.length; }
    get isLoaded() { return this.seen.size + this.broken.size >= this.total || this.isFull; }
    get isFull() { return this.encodedBytes >= ENCODED_BYTES; }

    // Tells where the person looks, and which way the pictures move.
    lookAt(frame, direction) {
        if (direction !== 0) this.direction = direction;
        if (frame === this.cursor) return;
        this.cursor = frame;
        this.work();
    }

    // Pictures that are larger than the window are decoded small.
    fitTo(width) {
        const [before, now] = [this.scaleFor(this.width), this.scaleFor(width)];
        this.width = width;
        if (before === now) return;
        for (const frame of [...this.decoded.keys()]) this.drop(frame);
        this.work();
    }

    // The picture nearest to a frame that can be shown now.
    nearest(frame) {
        let best = null;
        for (const other of this.decoded.keys())
            if (best === null || this.distance(other, frame) < this.distance(best, frame))
                best = other;
        return best;
    }

    bitmap(frame) { return this.decoded.get(frame); }

    // A frame at full size, for looking closely.
    async sharp(frame) {
        const source = this.encoded.get(frame);
        return source ? createImageBitmap(source) : null;
    }

    distance(a, b) {
        const way = Math.abs(a - b);
        return this.cyclic ? Math.min(way, this.count - way) : way;
    }

    work() {
        while (this.loading.size < PARALLEL_LOADS) {
            const frame = this.frameToLoad();
            if (frame === undefined) break;
            this.load(frame);
        }
        while (this.decoding.size < PARALLEL_DECODES) {
            const frame = this.frameToDecode();
            if (frame === undefined) break;
            this.decode(frame);
        }
    }

    isNeeded(frame) {
        return this.names[frame] !== null && !this.encoded.has(frame) &&
            !this.loading.has(frame) && !this.broken.has(frame);
    }

    frameToLoad() {
        if (this.next > FIRST_PASS && this.isNeeded(this.cursor)) return this.cursor;
        if (this.isFull) return this.ahead().find((frame) => this.isNeeded(frame));
        while (this.next < this.order.length) {
            const frame = this.order[this.next++];
            if (this.isNeeded(frame)) return frame;
        }
        return undefined;
    }

    // The frames that come next, where the pictures move.
    ahead() {
        return Array.from({ length: LOOK_AHEAD }, (_, step) => {
            const frame = this.cursor + step * this.direction;
            return this.cyclic ? (frame + this.count * LOOK_AHEAD) % this.count : frame;
        }).filter((frame) => frame >= 0 && frame < this.count);
    }

    async load(frame) {
        this.loading.add(frame);
        try {
            this.keep(frame, await this.source(frame));
        } catch {
            this.broken.add(frame);
        }
        this.loading.delete(frame);
        this.changed();
        this.work();
    }

    keep(frame, source) {
        const bytes = source.size ?? (this.recording.bytes || GUESSED_BYTES);
        source.bytes = bytes;
        this.seen.add(frame);
        this.encoded.set(frame, source);
        this.encodedBytes += bytes;
        for (const [other, old] of this.encoded) {
            if (this.encodedBytes <= ENCODED_BYTES + bytes || other === frame) break;
            this.encoded.delete(other);
            this.encodedBytes -= old.bytes;
        }
    }

    source(frame) {
        if (frame === this.recording.first) return loaded(this.first);
        if (this.recording.inside) return this.fromPage(frame);
        const address = encodeURIComponent(this.names[frame]);
        return location.protocol === 'file:' ? fromDisk(address) : fromServer(address);
    }

    // The text of a frame in the page is taken out of it: it is not kept twice.
    async fromPage(frame) {
        const text = await arrived(`frame-${frame}`);
        const blob = blobOf(text.textContent, 'image/jpeg');
        text.remove();
        return blob;
    }

    bytesDecoded() {
        const scale = this.scaleFor(this.width);
        return 4 * this.recording.width * this.recording.height * scale * scale;
    }

    capacity() { return Math.max(8, Math.floor(DECODED_BYTES / this.bytesDecoded())); }

    // What pictures are shrunk by while they are decoded; in steps, as windows change a little.
    scaleFor(width) {
        return Math.min(1, Math.ceil(8 * width / this.recording.width) / 8);
    }

    frameToDecode() {
        let best;
        for (const frame of this.encoded.keys()) {
            if (this.decoded.has(frame) || this.decoding.has(frame) || this.broken.has(frame)) continue;
            if (best === undefined || this.urgency(frame) < this.urgency(best)) best = frame;
        }
        if (best === undefined || this.decoded.size < this.capacity()) return best;
        const farthest = this.farthest();
        if (this.urgency(farthest) <= this.urgency(best)) return undefined;
        this.drop(farthest);
        return best;
    }

    // Near frames first, those behind the way of the pictures later.
    urgency(frame) {
        let way = (frame - this.cursor) * this.direction;
        if (this.cyclic) way = ((way + this.count / 2) % this.count + this.count) % this.count - this.count / 2;
        return way >= 0 ? way : -2 * way;
    }

    farthest() {
        let worst;
        for (const frame of this.decoded.keys())
            if (worst === undefined || this.urgency(frame) > this.urgency(worst)) worst = frame;
        return worst;
    }

    async decode(frame) {
        this.decoding.add(frame);
        const scale = this.scaleFor(this.width);
        const small = {
            resizeWidth: Math.ceil(this.recording.width * scale),
            resizeQuality: 'medium',
        };
        try {
            const source = this.encoded.get(frame);
            const bitmap = await (scale < 1 ? createImageBitmap(source, small) : createImageBitmap(source));
            if (scale === this.scaleFor(this.width)) this.decoded.set(frame, bitmap);
        } catch {
            this.broken.add(frame);
        }
        this.decoding.delete(frame);
        this.changed();
        this.work();
    }

    drop(frame) {
        this.decoded.get(frame).close();
        this.decoded.delete(frame);
    }
}

function blobOf(base64, type) {
    return new Blob([Uint8Array.fromBase64?.(base64) ?? bytesOf(atob(base64))], { type });
}

// For browsers that cannot read Base64 into bytes.
function bytesOf(text) {
    const bytes = new Uint8Array(text.length);
    for (let i = 0; i < text.length; ++i) bytes[i] = text.charCodeAt(i);
    return bytes;
}

async function loaded(image) {
    await image.decode();
    return image;
}

function fromDisk(address) {
    const image = new Image();
    image.src = address;
    return loaded(image);
}

async function fromServer(address) {
    const answer = await fetch(address);
    if (!answer.ok) throw new Error(`${address}: ${answer.status}`);
    return answer.blob();
}

// An element of the page that may still be on its way. It is whole once another one follows it.
async function arrived(id) {
    for (;;) {
        const isWhole = document.readyState !== 'loading';
        const found = element(id);
        if (found && (isWhole || found.nextElementSibling)) return found;
        if (isWhole) throw new Error(`${id} is not in the page`);
        await new Promise((resolve) => setTimeout(resolve, 20));
    }
}
