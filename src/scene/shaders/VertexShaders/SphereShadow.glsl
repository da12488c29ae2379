// The shadow of a unit sphere on the floor.
uniform mat4 u_ViewProjection;
uniform vec3 u_Up;
uniform vec3 u_LightVector;
uniform vec4 u_ReconPosAndSize;
uniform vec4 u_ModelColour;

attribute vec3 a_position;

varying vec4 v_Colour;

void main()
{
	v_Colour = u_ModelColour;
	vec3 position = a_position * u_ReconPosAndSize.w + u_ReconPosAndSize.xyz;
	// Along the light, down to the floor.
	position -= u_LightVector * (dot(position, u_Up) / max(dot(u_LightVector, u_Up), 1e-3));
	gl_Position = u_ViewProjection * vec4(position, 1.0);
}
