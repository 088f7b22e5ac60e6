// Where the window is larger than the picture, the colours of its borders fade into the ground.

const FADE_PX = 170;
const BORDER = 1 / 90;   // of the picture's height
const COLOURS = 12;      // along a border

class Sides {
    constructor(canvas) {
        this.canvas = canvas;
        this.pen = canvas.getContext('2d');
        this.blurred = document.createElement('canvas');
        this.blurredPen = this.blurred.getContext('2d');
        const look = () => { this.ground = getComputedStyle(document.documentElement).getPropertyValue('--ground').trim(); };
        matchMedia('(prefers-color-scheme: dark)').addEventListener('change', look);
        look();
    }

    // left, top: the picture's corner in the canvas; ratio: canvas points of a length
    draw(bitmap, left, top, ratio) {
        const { width, height } = this.canvas;
        const border = Math.max(1, Math.round(bitmap.height * BORDER));
        const fade = FADE_PX * ratio;
        if (top >= 1) {
            const size = [COLOURS, 1];
            this.fill(bitmap, [0, 0, bitmap.width, border], size, [0, 0, width, top], [0, top, 0, top - fade]);
            this.fill(bitmap, [0, bitmap.height - border, bitmap.width, border], size,
                [0, height - top, width, top], [0, height - top, 0, height - top + fade]);
        } else if (left >= 1) {
            const size = [1, COLOURS];
            this.fill(bitmap, [0, 0, border, bitmap.height], size, [0, 0, left, height], [left, 0, left - fade, 0]);
            this.fill(bitmap, [bitmap.width - border, 0, border, bitmap.height], size,
                [width - left, 0, left, height], [width - left, 0, width - left + fade, 0]);
        }
    }

    fill(bitmap, border, size, place, way) {
        [this.blurred.width, this.blurred.height] = size;
        this.blurredPen.imageSmoothingQuality = 'medium';
        this.blurredPen.drawImage(bitmap, ...border, 0, 0, ...size);
        this.pen.drawImage(this.blurred, ...place);
        const gradient = this.pen.createLinearGradient(...way);
        gradient.addColorStop(0, `${this.ground}00`);
        gradient.addColorStop(1, this.ground);
        this.pen.fillStyle = gradient;
        this.pen.fillRect(...place);
    }
}
